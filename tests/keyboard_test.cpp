// The real window driven by the keyboard: the list's keys, Tab to the segments, Copy of a row.
#include <QClipboard>
#include <QMenu>
#include <QPushButton>

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

TEST_F(KeyboardTest, EndSelectsTheLastRowAndReturnOpensItsReport) {
    Store({Result("1", "Box.ai"), Result("2", "Jar.ai"), Result("3", "Tin.ai")});
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
    Store({Result("1", "Box.ai")});
    auto window = StartFocused();
    Key(Qt::Key_Tab);
    ASSERT_TRUE(window->MainTabs()->Widget()->isAncestorOf(QApplication::focusWidget()))
        << "Tab reaches a segment";
    EXPECT_EQ(static_cast<QPushButton*>(QApplication::focusWidget())->text(), "Installation");
    Key(Qt::Key_Space);
    EXPECT_EQ(window->PagePanel1()->Value(), 0);
}

TEST_F(KeyboardTest, CopyPutsTheHeadingLineAndTheSelectedRowOnTheClipboard) {
    Store({Result("1", "Box.ai"), Result("2", "Jar\tlid.ai")});
    auto window = StartFocused();
    auto* copy = InMenuBar<QAction>(window, "EditCopy");
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
    EXPECT_EQ(QApplication::clipboard()->text().toStdString(),
              "Date - Time\tDocument\tRead Value\tGrade\n2018-11-02\tJar lid.ai\t 2\tA\n");
}

}  // namespace
