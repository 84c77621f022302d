// The window as built from its control table: where each control stands and what it says.
#include <QComboBox>
#include <QHeaderView>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTabWidget>
#include <QTableView>

#include "drawing/rect_box.h"
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

QString LabelText(const Ref<Label>& label) {
    return static_cast<QLabel*>(label->Widget())->text();
}

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
    for (long long i = 0; i <= 8; ++i) {
        EXPECT_EQ(window->Label6(i)->Index(), i);
    }
    for (long long i = 0; i <= 7; ++i) {
        EXPECT_EQ(window->Label5(i)->Index(), i);
    }
    EXPECT_TRUE(window->_ControlByNameIndex("Label5", 8).IsNil());
    EXPECT_THROW(window->Label5(8)->Text(), NilObjectException);
    EXPECT_EQ(window->PagePanel1()->Index(), Control::kNoIndex);
}

TEST_F(WindowTableTest, TextsAndFontsAreAsBuilt) {
    EXPECT_EQ(LabelText(window->Label2()), "Verifier Plugin Installation");
    EXPECT_FALSE(window->Label2()->Widget()->isEnabled());
    EXPECT_TRUE(window->Label2()->Widget()->font().bold());
    EXPECT_EQ(window->Label2()->Widget()->font().pixelSize(), 24);
    EXPECT_EQ(window->Label1()->Text(),
              "Depending on which version of Acrobat or Illustrator you have any plugins need "
              "installing in different places.\r\rThis is why we have created this installer for "
              "you.\r\rSimply choose your version of your Adobe product below and click Install, "
              "you will need to restart your Adobe application to see the plugin.");
    EXPECT_TRUE(static_cast<QLabel*>(window->Label1()->Widget())->wordWrap());
    EXPECT_EQ(LabelText(window->Label3()), "Double Click on a result to see the full report");
    EXPECT_EQ(LabelText(window->Label4()), "Stored Verification Results");
    const char* captions[] = {"Code Type", "Code Reads",   "Symbol Length", "Scale",
                              "BWR",       "Bar Deviance", "Document",      "Grade"};
    for (long long i = 0; i < 8; ++i) {
        EXPECT_EQ(window->Label5(i)->Text(), captions[i]);
        EXPECT_TRUE(static_cast<QLabel*>(window->Label5(i)->Widget())->alignment() &
                    Qt::AlignRight);
    }
    for (long long i = 0; i <= 8; ++i) {
        EXPECT_EQ(window->Label6(i)->Text(), "Code Type");
    }
    EXPECT_TRUE(static_cast<QLabel*>(window->Label6(6)->Widget())->alignment() & Qt::AlignHCenter);
    EXPECT_TRUE(static_cast<QLabel*>(window->Label6(7)->Widget())->wordWrap());

    auto* install = static_cast<QPushButton*>(window->PushButton1()->Widget());
    auto* close = static_cast<QPushButton*>(window->PushButton2()->Widget());
    EXPECT_EQ(install->text(), "Install Now");
    EXPECT_EQ(close->text(), "Close");
    EXPECT_TRUE(install->isDefault());
    EXPECT_FALSE(close->isDefault());
    EXPECT_TRUE(static_cast<QPlainTextEdit*>(window->TextArea1()->Widget())->isReadOnly());
    EXPECT_EQ(window->TextArea1()->Widget()->font().family(), "Courier");
}

// The widths, fitted to the list in their proportions, are the keyboard tests' affair.
TEST_F(WindowTableTest, TheListHasItsFourHeadings) {
    auto* view = static_cast<QTableView*>(window->Listbox1()->Widget());
    const char* headings[] = {"Date - Time", "Document", "Read Value", "Grade"};
    ASSERT_EQ(view->model()->columnCount(), 4);
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(view->model()->headerData(i, Qt::Horizontal).toString(), headings[i]);
    }
    EXPECT_TRUE(view->horizontalHeader()->isVisible() || !view->isVisible());
    EXPECT_EQ(window->Listbox1()->ListIndex(), -1);
}

TEST_F(WindowTableTest, TabsSegmentsAndPopupAreAsBuilt) {
    auto* tabs = static_cast<QTabWidget*>(window->TabPanel1()->Widget());
    ASSERT_EQ(tabs->count(), 2);
    EXPECT_EQ(tabs->tabText(0), "Measurements");
    EXPECT_EQ(tabs->tabText(1), "Deviances");
    EXPECT_EQ(tabs->currentIndex(), 0);

    auto items = window->MainTabs()->Items();
    ASSERT_EQ(items.Count(), 2);
    EXPECT_EQ(items[0]->Title(), "Installation");
    EXPECT_EQ(items[1]->Title(), "Verification Results");
    EXPECT_EQ(items[0]->Width(), 460);
    EXPECT_TRUE(items[0]->Selected());
    EXPECT_FALSE(items[1]->Selected());
    EXPECT_EQ(window->MainTabs()->Widget()->width(), 920) << "sized to fit its two segments";

    auto popup = window->PopupMenu1();
    EXPECT_EQ(popup->Text(), "Choose Your Adobe Product");
    const char* rows[] = {"Choose Your Adobe Product",
                          "Acrobat X",
                          "Acrobat XI",
                          "Acrobat 2017",
                          "Acrobat DC",
                          "-",
                          "Illustrator CC"};
    ASSERT_EQ(popup->ListCount(), 7);
    for (long long i = 0; i < 7; ++i) {
        EXPECT_EQ(popup->List(i), rows[i]);
    }
}
