// The real window driven by the keyboard: the list's keys, the focus order through the page,
// Copy of a row, columns that fit the list, the tooltip of a cut cell.
#include <QAccessible>
#include <QClipboard>
#include <QHeaderView>
#include <QHelpEvent>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QScrollBar>
#include <QToolTip>

#include "drawing/rect_box.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

demo::StoredResult Row(int n, const std::string& document, const std::string& readValue = "42") {
    const std::string id = std::to_string(n);
    return {id, "2018-11-" + id, document, "B",
            demo::ReportText(demo::Layout::A, readValue, "EAN 8", 2)};
}

std::vector<demo::StoredResult> Rows(int count) {
    std::vector<demo::StoredResult> rows;
    for (int i = 1; i <= count; ++i) {
        rows.push_back(Row(i, "Doc " + std::to_string(i) + ".ai"));
    }
    return rows;
}

class KeyboardTest : public WindowTest {
  protected:
    // The window as the user has it: shown, active, with the list focused.
    Ref<class Window1> StartFocused() {
        auto window = StartUp();
        QApplication::setActiveWindow(window->Native());
        View(window).setFocus();
        ProcessEvents();
        return window;
    }
    // One stored row, opened by Return.
    Ref<class Window1> StartOnTheReport() {
        Store({Row(1, "Box.ai")});
        auto window = StartFocused();
        window->Listbox1()->SetListIndex(0);
        Key(window, Qt::Key_Return);
        return window;
    }
    void Key(const Ref<class Window1>&, int key, Qt::KeyboardModifiers modifiers = {}) {
        QWidget* focus = QApplication::focusWidget();
        ASSERT_NE(focus, nullptr);
        QTest::keyClick(focus, static_cast<Qt::Key>(key), modifiers);
        ProcessEvents();
    }
    QAction* EditAction(const Ref<class Window1>& window, const char* name) {
        return static_cast<QMainWindow*>(window->Native())->menuBar()->findChild<QAction*>(name);
    }
};

TEST_F(KeyboardTest, ReturnOrEnterOnTheSelectedRowOpensItsReport) {
    Store({Row(1, "Box.ai"), Row(2, "Jar.ai"), Row(3, "Tin.ai")});
    auto window = StartFocused();
    Key(window, Qt::Key_Return);
    EXPECT_EQ(window->PagePanel1()->Value(), 1) << "no row selected, nothing to open";

    Key(window, Qt::Key_End);
    ASSERT_EQ(window->Listbox1()->ListIndex(), 2);
    Key(window, Qt::Key_Return);
    EXPECT_EQ(window->PagePanel1()->Value(), 2);
    EXPECT_EQ(window->Label6(7)->Text(), "Tin.ai");

    window->PushButton2()->Push();
    View(window).setFocus();
    window->Listbox1()->SetListIndex(1);
    Key(window, Qt::Key_Enter, Qt::KeypadModifier);
    EXPECT_EQ(window->PagePanel1()->Value(), 2);
    EXPECT_EQ(window->Label6(7)->Text(), "Jar.ai");
}

TEST_F(KeyboardTest, HomeEndAndPageKeysMoveByRowsAndNeverSideways) {
    Store(Rows(40));
    auto window = StartFocused();
    auto list = window->Listbox1();
    QTableView& view = View(window);
    Key(window, Qt::Key_End);
    EXPECT_EQ(list->ListIndex(), 39);
    EXPECT_EQ(view.horizontalScrollBar()->value(), 0);
    EXPECT_EQ(view.horizontalHeader()->sectionViewportPosition(0), 0) << "Date - Time whole";
    Key(window, Qt::Key_Home);
    EXPECT_EQ(list->ListIndex(), 0);
    Key(window, Qt::Key_PageDown);
    const long long page = list->ListIndex();
    EXPECT_GT(page, 10) << "a page of 25-pixel rows in a list 429 high";
    Key(window, Qt::Key_PageUp);
    EXPECT_EQ(list->ListIndex(), 0);
}

TEST_F(KeyboardTest, TypingFindsTheNextRowBeginningWithItInTheSortColumn) {
    Store({Row(1, "Tin.ai"), Row(2, "jug.ai"), Row(3, "Box.ai"), Row(4, "Jar.ai")});
    auto window = StartFocused();
    auto list = window->Listbox1();
    list->PressHeading(1);
    ProcessEvents();
    QTest::keyClicks(QApplication::focusWidget(), "j");
    EXPECT_EQ(list->Cell(list->ListIndex(), 1), "Jar.ai");
    QTest::keyClicks(QApplication::focusWidget(), "j");
    EXPECT_EQ(list->Cell(list->ListIndex(), 1), "jug.ai") << "the same letter steps on";
    QTest::qWait(QApplication::keyboardInputInterval() + 50);
    QTest::keyClicks(QApplication::focusWidget(), "ti");
    EXPECT_EQ(list->Cell(list->ListIndex(), 1), "Tin.ai");
}

TEST_F(KeyboardTest, TabLeavesTheListForTheSegmentsWhichSpaceAndArrowsChoose) {
    Store(Rows(3));
    auto window = StartFocused();
    QWidget* segments = window->MainTabs()->Widget();
    Key(window, Qt::Key_Tab);
    ASSERT_TRUE(segments->isAncestorOf(QApplication::focusWidget())) << "Tab reaches a segment";
    EXPECT_EQ(static_cast<QPushButton*>(QApplication::focusWidget())->text(), "Installation");
    Key(window, Qt::Key_Space);
    EXPECT_EQ(window->PagePanel1()->Value(), 0);
    EXPECT_TRUE(window->MainTabs()->Items()[0]->Selected());

    Key(window, Qt::Key_Right);
    EXPECT_EQ(window->PagePanel1()->Value(), 1) << "the arrow chooses the next segment";
    EXPECT_TRUE(window->MainTabs()->Items()[1]->Selected());
    EXPECT_EQ(static_cast<QPushButton*>(QApplication::focusWidget())->text(),
              "Verification Results");
    Key(window, Qt::Key_Tab);
    EXPECT_EQ(QApplication::focusWidget(), &View(window)) << "then the list of this page";
    Key(window, Qt::Key_Backtab, Qt::ShiftModifier);
    EXPECT_TRUE(segments->isAncestorOf(QApplication::focusWidget()));
}

TEST_F(KeyboardTest, TabOnTheReportPageGoesByTheTabIndexOfItsControls) {
    auto window = StartOnTheReport();
    ASSERT_EQ(window->PagePanel1()->Value(), 2);
    window->MainTabs()->Widget()->findChildren<QPushButton*>().last()->setFocus();
    std::vector<QWidget*> visited;
    for (int i = 0; i < 4; ++i) {
        Key(window, Qt::Key_Tab);
        visited.push_back(QApplication::focusWidget());
    }
    EXPECT_EQ(visited[0], window->PushButton2()->Widget()) << "Close, tab index 1";
    EXPECT_TRUE(window->TabPanel1()->Widget()->isAncestorOf(visited[1])) << "the tabs, 2";
    EXPECT_EQ(visited[2], window->TextArea1()->Widget()) << "the pane of the chosen tab";
    EXPECT_TRUE(window->MainTabs()->Widget()->isAncestorOf(visited[3])) << "round to the top";
}

TEST_F(KeyboardTest, CopyPutsTheHeadingLineAndTheSelectedRowOnTheClipboard) {
    Store({Row(1, "Box.ai"), Row(2, "Jar\tlid.ai", "0361")});
    auto window = StartFocused();
    QApplication::clipboard()->setText("before");
    QAction* copy = EditAction(window, "EditCopy");
    ASSERT_NE(copy, nullptr);
    emit static_cast<QMenu*>(copy->parent())->aboutToShow();
    EXPECT_FALSE(copy->isEnabled()) << "nothing selected";
    emit static_cast<QMenu*>(copy->parent())->aboutToHide();
    Key(window, Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QApplication::clipboard()->text(), "before");

    Key(window, Qt::Key_End);
    emit static_cast<QMenu*>(copy->parent())->aboutToShow();
    EXPECT_TRUE(copy->isEnabled());
    emit static_cast<QMenu*>(copy->parent())->aboutToHide();
    Key(window, Qt::Key_C, Qt::ControlModifier);
    const std::string readValue = window->Listbox1()->Cell(1, 2);
    ASSERT_NE(readValue.find("0361"), std::string::npos);
    EXPECT_EQ(
        QApplication::clipboard()->text().toStdString(),
        "Date - Time\tDocument\tRead Value\tGrade\n2018-11-2\tJar lid.ai\t" + readValue + "\tB\n");
}

TEST_F(KeyboardTest, CopyInTheReportPaneStillCopiesItsSelectedText) {
    auto window = StartOnTheReport();
    ASSERT_EQ(window->PagePanel1()->Value(), 2);
    window->TextArea1()->Widget()->setFocus();
    ProcessEvents();
    window->EditSelectAll()->Action();
    window->EditCopy()->Action();
    const auto* pane = static_cast<QPlainTextEdit*>(window->TextArea1()->Widget());
    EXPECT_EQ(QApplication::clipboard()->text(), pane->toPlainText());
}

class ColumnTest : public WindowTest, public ::testing::WithParamInterface<int> {};

// Nothing is hidden under the scrollbar or beyond the right edge, and the proportions hold.
TEST_P(ColumnTest, TheFourColumnsFitTheListWithOrWithoutItsScrollbar) {
    Store(Rows(GetParam()));
    auto window = StartUp();
    ProcessEvents();
    QTableView& view = View(window);
    int total = 0;
    for (int column = 0; column < 4; ++column) {
        total += view.columnWidth(column);
    }
    EXPECT_EQ(total, view.viewport()->width());
    EXPECT_EQ(view.horizontalScrollBar()->maximum(), 0);
    const int inside = view.width() - 2 * view.frameWidth();
    EXPECT_NEAR(view.columnWidth(0), 200 * inside / 875, 1);
    EXPECT_NEAR(view.columnWidth(2), 300 * inside / 875, 1);
    EXPECT_NEAR(view.columnWidth(3), 50 * inside / 875, 1);
    const QFontMetrics metrics(view.horizontalHeader()->font());
    EXPECT_GT(view.columnWidth(3), metrics.horizontalAdvance("Grade")) << "the heading is whole";
}

INSTANTIATE_TEST_SUITE_P(Rows, ColumnTest, ::testing::Values(1, 60), [](const auto& info) {
    return info.param == 1 ? std::string("NoScrollbar") : std::string("Scrollbar");
});

TEST_F(KeyboardTest, ACutCellShowsItsWholeTextInATooltip) {
    Store({Row(1, "Box.ai",
               "(01)09501101530003(17)251231(10)LOT-2025-ABCDEFGHIJ(21)"
               "SERIAL0123456789ABCDEFGHIJKLMNOPQR")});
    auto window = StartUp();
    ProcessEvents();
    const std::string gs1 = window->Listbox1()->Cell(0, 2);
    ASSERT_GE(gs1.size(), 90u);
    QTableView& view = View(window);
    auto showTip = [&](int column) {
        const QRect cell = view.visualRect(view.model()->index(0, column));
        QHelpEvent help(QEvent::ToolTip, cell.center(),
                        view.viewport()->mapToGlobal(cell.center()));
        QApplication::sendEvent(view.viewport(), &help);
    };
    showTip(2);
    EXPECT_TRUE(QToolTip::isVisible());
    EXPECT_EQ(QToolTip::text().toStdString(), gs1);
    showTip(3);
    EXPECT_TRUE(QTest::qWaitFor([] { return !QToolTip::isVisible(); }, 2000))
        << "a grade that fits has no tooltip";
}

TEST_F(KeyboardTest, TheListTheFramesTheSegmentsAndTheButtonsHaveAccessibleNames) {
    auto window = StartUp();
    auto name = [](QWidget* widget) {
        return QAccessible::queryAccessibleInterface(widget)->text(QAccessible::Name);
    };
    EXPECT_EQ(name(&View(window)), "Date - Time, Document, Read Value, Grade");
    EXPECT_EQ(name(window->Canvas2()->Widget()), "Verification Results");
    EXPECT_EQ(name(window->PushButton1()->Widget()), "Install Now");
    const auto segments = window->MainTabs()->Widget()->findChildren<QPushButton*>();
    ASSERT_EQ(segments.size(), 2);
    EXPECT_EQ(name(segments[1]), "Verification Results");
}

}  // namespace
