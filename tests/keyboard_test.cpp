// The real window driven by the keyboard: the list's keys, Tab to the segments, Copy of a row.
#include <QClipboard>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>

#include "window_fixture.h"

using namespace testsupport;

namespace {

demo::StoredResult Row(int n, const std::string& document, const std::string& readValue = "42") {
    const std::string id = std::to_string(n);
    return {id, "2018-11-" + id, document, "B",
            demo::ReportText(demo::Layout::A, readValue, "EAN 8", 2)};
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
    void Key(int key, Qt::KeyboardModifiers modifiers = {}) {
        QWidget* focus = QApplication::focusWidget();
        ASSERT_NE(focus, nullptr);
        QTest::keyClick(focus, static_cast<Qt::Key>(key), modifiers);
        ProcessEvents();
    }
};

TEST_F(KeyboardTest, EndSelectsTheLastRowAndReturnOpensItsReport) {
    Store({Row(1, "Box.ai"), Row(2, "Jar.ai"), Row(3, "Tin.ai")});
    auto window = StartFocused();
    Key(Qt::Key_Return);
    EXPECT_EQ(window->PagePanel1()->Value(), 1) << "no row selected, nothing to open";

    Key(Qt::Key_End);
    ASSERT_EQ(window->Listbox1()->ListIndex(), 2);
    Key(Qt::Key_Return);
    EXPECT_EQ(window->PagePanel1()->Value(), 2);
    EXPECT_EQ(window->Label6(7)->Text(), "Tin.ai");
}

TEST_F(KeyboardTest, TabLeavesTheListForTheSegmentsWhichSpaceChooses) {
    Store({Row(1, "Box.ai")});
    auto window = StartFocused();
    Key(Qt::Key_Tab);
    ASSERT_TRUE(window->MainTabs()->Widget()->isAncestorOf(QApplication::focusWidget()))
        << "Tab reaches a segment";
    EXPECT_EQ(static_cast<QPushButton*>(QApplication::focusWidget())->text(), "Installation");
    Key(Qt::Key_Space);
    EXPECT_EQ(window->PagePanel1()->Value(), 0);
}

TEST_F(KeyboardTest, CopyPutsTheHeadingLineAndTheSelectedRowOnTheClipboard) {
    Store({Row(1, "Box.ai"), Row(2, "Jar\tlid.ai", "0361")});
    auto window = StartFocused();
    auto* copy =
        static_cast<QMainWindow*>(window->Native())->menuBar()->findChild<QAction*>("EditCopy");
    ASSERT_NE(copy, nullptr);
    auto offered = [copy] {
        emit static_cast<QMenu*>(copy->parent())->aboutToShow();
        const bool enabled = copy->isEnabled();
        emit static_cast<QMenu*>(copy->parent())->aboutToHide();
        return enabled;
    };
    QApplication::clipboard()->setText("before");
    EXPECT_FALSE(offered()) << "nothing selected";
    Key(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QApplication::clipboard()->text(), "before");

    Key(Qt::Key_End);
    EXPECT_TRUE(offered());
    Key(Qt::Key_C, Qt::ControlModifier);
    const std::string readValue = window->Listbox1()->Cell(1, 2);
    ASSERT_NE(readValue.find("0361"), std::string::npos);
    EXPECT_EQ(
        QApplication::clipboard()->text().toStdString(),
        "Date - Time\tDocument\tRead Value\tGrade\n2018-11-2\tJar lid.ai\t" + readValue + "\tB\n");
}

}  // namespace
