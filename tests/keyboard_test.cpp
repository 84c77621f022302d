// The real window driven by the keyboard: the list's keys and its focus, the pages' focus, Tab to
// the segments, Copy of a row.
#include <QAbstractScrollArea>
#include <QClipboard>
#include <QMenu>
#include <QPushButton>

#include "contrast.h"
#include "platform/runtime/appearance.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

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

// End selects the last row and Return opens its report. A page that comes into view takes the
// focus at its first control in the keyboard order when the focus would go out of view with the
// page before; a text pane rings itself while focused. Tab leaves the list for the segments,
// where Space chooses a page and the focus stays.
TEST_F(KeyboardTest, ThroughThePagesByKeys) {
    auto window = StartUp({Result("1", "Box.ai"), Result("2", "Jar.ai"), Result("3", "Tin.ai")});
    QApplication::setActiveWindow(window->Native());
    ASSERT_EQ(QApplication::focusWidget(), &View(window)) << "the list page, at start";
    Key(Qt::Key_Return);
    EXPECT_EQ(window->PagePanel1()->Value(), 1) << "no row selected, nothing to open";
    Key(Qt::Key_End);
    ASSERT_EQ(window->Listbox1()->ListIndex(), 2);
    Key(Qt::Key_Return);
    EXPECT_EQ(window->PagePanel1()->Value(), 2);
    EXPECT_EQ(window->Label6(7)->Text(), "Tin.ai");

    EXPECT_EQ(QApplication::focusWidget(), window->PushButton2()->Widget());
    auto* pane = static_cast<QAbstractScrollArea*>(window->TextArea1()->Widget());
    const QRgb ground = Pixel(pane->viewport(), 1, 1);
    Key(Qt::Key_Tab);
    Key(Qt::Key_Tab);
    ASSERT_EQ(QApplication::focusWidget(), pane);
    EXPECT_GE(Contrast(Pixel(pane->viewport(), 1, 1), ground), 4.5) << "the pane is ringed";
    window->PushButton2()->Push();
    ASSERT_EQ(QApplication::focusWidget(), &View(window));

    Key(Qt::Key_Tab);
    ASSERT_TRUE(window->MainTabs()->Widget()->isAncestorOf(QApplication::focusWidget()))
        << "Tab reaches a segment";
    EXPECT_EQ(static_cast<QPushButton*>(QApplication::focusWidget())->text(), "Installation");
    Key(Qt::Key_Space);
    EXPECT_EQ(window->PagePanel1()->Value(), 0);
    EXPECT_EQ(static_cast<QPushButton*>(QApplication::focusWidget())->text(), "Installation")
        << "the focus stays on the segments that chose the page";
    window->MainTabs()->Press(1);
    View(window).setFocus();
    window->MainTabs()->Press(0);
    EXPECT_EQ(QApplication::focusWidget(), window->PushButton1()->Widget());
}

// The list that gets the focus rings its first row without choosing it; the first Down chooses
// that row. The ring and the chosen row's text read on their grounds in either appearance.
TEST_F(KeyboardTest, TheFocusedListRingsItsCurrentRowWhichTheFirstDownChooses) {
    Store({Result("1", "Box.ai"), Result("2", "Jar.ai"), Result("3", "Tin.ai")});
    for (auto appearance : {Appearance::Light, Appearance::Dark}) {
        SetAppearanceForTesting(appearance);
        auto window = StartFocused();
        QWidget* rows = View(window).viewport();
        const QRgb ground = Pixel(rows, 120, 12);
        EXPECT_GE(Contrast(Pixel(rows, 2, 12), ground), 4.5) << "the current row is ringed";
        EXPECT_EQ(window->Listbox1()->ListIndex(), -1);

        Key(Qt::Key_Down);
        EXPECT_EQ(window->Listbox1()->ListIndex(), 0);
        const QImage chosen = rows->grab(QRect(0, 0, 400, 25)).toImage();
        EXPECT_GE(Contrast(Ink(chosen, Ground(chosen)), Ground(chosen)), 4.5);
        Key(Qt::Key_Down);
        EXPECT_EQ(window->Listbox1()->ListIndex(), 1);
        window->Close();
        ProcessEvents();
    }
}

TEST_F(KeyboardTest, CopyPutsTheHeadingLineAndTheSelectedRowOnTheClipboard) {
    Store({Result("1", "Box.ai"), Result("2", "Jar\tlid.ai")});
    auto window = StartFocused();
    auto* copy = InMenuBar<QAction>(window, "EditCopy");
    ASSERT_NE(copy, nullptr);
    EXPECT_EQ(copy->shortcut(), QKeySequence(QKeySequence::Copy));
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
    EXPECT_EQ(QApplication::clipboard()->text().toStdString(),
              "Date - Time\tDocument\tRead Value\tGrade\n2018-11-02\tJar lid.ai\t 2\tA\n");
}

}  // namespace
