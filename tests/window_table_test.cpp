// The window as built from its control table: one parent, indexed sets, the starting states.
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTabWidget>

#include "shell/app.h"
#include "shell/startup.h"
#include "shell/window1.h"
#include "support.h"

using namespace testsupport;

namespace {

class WindowTableTest : public SlateTest {
  protected:
    void SetUp() override {
        _EarlyStartup();
        window = Window1();
    }
    TempDir tree;
    ScopedRoot root{tree.Path()};
    Ref<class Window1> window;
};

}  // namespace

TEST_F(WindowTableTest, EveryControlIsAChildOfTheClientArea) {
    EXPECT_EQ(window->Controls().size(), 33u);
    for (const Ref<Control>& control : window->Controls()) {
        EXPECT_EQ(control->Widget()->parentWidget(), window->Client()) << control->Name();
    }
    EXPECT_EQ(window->MainTabs()->Widget()->geometry().topLeft(), QPoint(20, 20));
    EXPECT_EQ(window->MainTabs()->Widget()->height(), 24);
}

TEST_F(WindowTableTest, ControlSetsAnswerToTheirOwnIndexes) {
    EXPECT_EQ(window->Label6(8)->Index(), 8);
    EXPECT_EQ(window->Label5(7)->Index(), 7);
    EXPECT_TRUE(window->_ControlByNameIndex("Label5", 8).IsNil());
    EXPECT_THROW(window->Label5(8)->Text(), NilObjectException);
    EXPECT_EQ(window->PagePanel1()->Index(), Control::kNoIndex);
}

// Only what the controls do; their texts are checked where they are met.
TEST_F(WindowTableTest, TheControlsStartAsAUserFindsThem) {
    auto* install = static_cast<QPushButton*>(window->PushButton1()->Widget());
    EXPECT_TRUE(install->isDefault());
    EXPECT_FALSE(static_cast<QPushButton*>(window->PushButton2()->Widget())->isDefault());
    EXPECT_TRUE(static_cast<QPlainTextEdit*>(window->TextArea1()->Widget())->isReadOnly());
    EXPECT_FALSE(window->Label2()->Widget()->isEnabled());
    EXPECT_EQ(static_cast<QTabWidget*>(window->TabPanel1()->Widget())->currentIndex(), 0);
    EXPECT_EQ(window->MainTabs()->Widget()->width(), 920) << "sized to fit its two segments";
    EXPECT_EQ(window->Listbox1()->ListIndex(), -1);
    EXPECT_EQ(window->PopupMenu1()->List(0), window->PopupMenu1()->Text()) << "the prompt row";
    EXPECT_EQ(window->PopupMenu1()->ListCount(), 7);
}
