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

struct Placement {
    const char* name;
    long long index;
    int left, top, width, height;
};

// Window coordinates, whatever the control's parent.
const Placement kPlacements[] = {
    {"PagePanel1", Control::kNoIndex, 20, 56, 928, 552},
    {"Canvas3", Control::kNoIndex, 57, 95, 871, 461},
    {"PushButton1", Control::kNoIndex, 359, 471, 249, 20},
    {"PopupMenu1", Control::kNoIndex, 359, 398, 249, 20},
    {"Label1", Control::kNoIndex, 123, 223, 705, 132},
    {"Label2", Control::kNoIndex, 272, 154, 422, 43},
    {"Canvas2", Control::kNoIndex, 40, 76, 897, 520},
    {"Label3", Control::kNoIndex, 60, 108, 866, 35},
    {"Canvas1", Control::kNoIndex, 52, 101, 876, 436},
    {"Listbox1", Control::kNoIndex, 52, 151, 876, 429},
    {"Label4", Control::kNoIndex, 217, 69, 533, 20},
    {"PushButton2", Control::kNoIndex, 827, 556, 80, 20},
    {"TabPanel1", Control::kNoIndex, 464, 128, 443, 401},
    {"TextArea1", Control::kNoIndex, 501, 177, 386, 332},
    {"TextArea2", Control::kNoIndex, 484, 177, 403, 332},
    {"Label5", 0, 70, 211, 100, 20},
    {"Label6", 0, 185, 211, 201, 20},
    {"Label5", 1, 70, 235, 100, 20},
    {"Label6", 1, 185, 235, 201, 20},
    {"Label5", 2, 70, 260, 100, 20},
    {"Label6", 2, 185, 260, 201, 20},
    {"Label5", 3, 70, 284, 100, 20},
    {"Label6", 3, 185, 284, 201, 20},
    {"Label5", 4, 70, 307, 100, 20},
    {"Label6", 4, 185, 307, 201, 20},
    {"Label5", 5, 70, 331, 100, 20},
    {"Label6", 5, 185, 331, 201, 20},
    {"Label6", 6, 82, 363, 322, 20},
    {"Label5", 6, 70, 164, 100, 20},
    {"Label6", 7, 185, 164, 201, 49},
    {"Label5", 7, 70, 395, 100, 20},
    {"Label6", 8, 185, 395, 201, 20},
};

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

TEST_F(WindowTableTest, EveryControlStandsWhereTheTableSays) {
    EXPECT_EQ(window->Controls().size(), 33u);
    for (const Placement& p : kPlacements) {
        Ref<Control> control = p.index == Control::kNoIndex
                                   ? window->_ControlByName(p.name)
                                   : window->_ControlByNameIndex(p.name, p.index);
        ASSERT_FALSE(control.IsNil()) << p.name << " " << p.index;
        EXPECT_EQ(control->Widget()->geometry(), QRect(p.left, p.top, p.width, p.height))
            << p.name << " " << p.index;
        EXPECT_EQ(control->Widget()->parentWidget(), window->Client());
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

TEST_F(WindowTableTest, TheListHasItsFourHeadingsAndWidths) {
    auto* view = static_cast<QTableView*>(window->Listbox1()->Widget());
    const char* headings[] = {"Date - Time", "Document", "Read Value", "Grade"};
    const int widths[] = {200, 325, 300, 50};
    ASSERT_EQ(view->model()->columnCount(), 4);
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(view->model()->headerData(i, Qt::Horizontal).toString(), headings[i]);
        EXPECT_EQ(view->columnWidth(i), widths[i]);
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
