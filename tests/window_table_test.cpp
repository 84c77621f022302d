// The window as built from its control table: indexed sets, fonts, the starting states.
#include <QApplication>
#include <QFontInfo>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTabWidget>

#include "shell/app.h"
#include "shell/startup.h"
#include "shell/window1.h"
#include "support.h"

using namespace testsupport;

namespace {

class WindowTableTest : public RootedTest {
  protected:
    void SetUp() override {
        _EarlyStartup();
        window = Window1();
    }
    Ref<class Window1> window;
};

}  // namespace

// Only what the controls do; their texts and rows are checked where they are met.
TEST_F(WindowTableTest, TheControlsStartAsAUserFindsThem) {
    EXPECT_THROW(window->Label5(8)->Text(), NilObjectException) << "a set has its own indexes";
    auto* install = static_cast<QPushButton*>(window->PushButton1()->Widget());
    EXPECT_TRUE(install->isDefault());
    EXPECT_FALSE(static_cast<QPushButton*>(window->PushButton2()->Widget())->isDefault());
    EXPECT_TRUE(static_cast<QPlainTextEdit*>(window->TextArea1()->Widget())->isReadOnly());
    EXPECT_EQ(window->MainTabs()->Widget()->width(), 920) << "sized to fit its two segments";
}

// A control on a page that is not shown may get its font late, but never shows without it.
TEST_F(WindowTableTest, EachControlShowsInItsTableFont) {
    struct Expected {
        Ref<Control> control;
        long long page;
        QString family;  // empty: the desktop's font
        int pixelSize;
        bool bold;
    };
    const QFont desktop = QApplication::font();
    const std::vector<Expected> table = {
        {window->PushButton1(), 0, "", -1, false},      {window->Label1(), 0, "Arial", 14, false},
        {window->Label2(), 0, "Arial", 24, true},       {window->Label3(), 1, "Arial", 18, false},
        {window->Listbox1(), 1, "", -1, false},         {window->Label4(), 2, "Arial", 18, false},
        {window->Label5(6), 2, "Arial", 12, false},     {window->Label6(7), 2, "Arial", 12, false},
        {window->TextArea1(), 2, "Courier", -1, false}, {window->PushButton2(), 2, "", -1, false},
    };
    for (long long page : {1, 2, 0}) {
        window->PagePanel1()->SetValue(page);
        for (const Expected& e : table) {
            if (e.page != page) {
                continue;
            }
            const QFont font = e.control->Widget()->font();
            const std::string where = e.control->Name() + " on page " + std::to_string(page);
            // A family missing here shows in the face that the desktop gives in its place.
            EXPECT_EQ(QFontInfo(font).family(),
                      QFontInfo(e.family.isEmpty() ? desktop : QFont(e.family)).family())
                << where;
            EXPECT_EQ(font.pixelSize(), e.family.isEmpty() ? desktop.pixelSize() : e.pixelSize)
                << where;
            EXPECT_EQ(font.bold(), e.bold) << where;
        }
    }
}

TEST_F(WindowTableTest, ATextAreaLaysItsTextOutInItsOwnFontEvenWhileHidden) {
    ASSERT_FALSE(window->TextArea2()->IsShown());
    window->TextArea2()->SetText("Bar 1 660");
    EXPECT_EQ(QFontInfo(window->TextArea2()->Widget()->font()).family(),
              QFontInfo(QFont("Courier")).family());
}

// The report page's controls hold what they were given while hidden, and lie over and under
// each other in the order of the table.
TEST_F(WindowTableTest, TheReportPageShowsWhatItWasGivenWhileHidden) {
    window->Label6(3)->SetText("Code 128");
    window->TabPanel1()->SetValue(1);
    window->TextArea2()->SetText("Bar 1 660");
    QWidget* deviances = window->TextArea2()->Widget();

    window->PagePanel1()->SetValue(2);
    ProcessEvents();
    EXPECT_EQ(static_cast<QLabel*>(window->Label6(3)->Widget())->text(), "Code 128");
    EXPECT_EQ(static_cast<QTabWidget*>(window->TabPanel1()->Widget())->currentIndex(), 1);
    EXPECT_EQ(static_cast<QPlainTextEdit*>(deviances)->toPlainText(), "Bar 1 660");
    EXPECT_TRUE(deviances->isVisible());
    EXPECT_FALSE(window->TextArea1()->Widget()->isVisible()) << "on the tab not chosen";

    window->TabPanel1()->SetValue(0);
    EXPECT_TRUE(window->TextArea1()->Widget()->isVisible());
    const QObjectList order = window->Client()->children();
    const qsizetype panel = order.indexOf(window->TabPanel1()->Widget());
    EXPECT_GT(order.indexOf(deviances), panel);
    EXPECT_GT(order.indexOf(window->TextArea1()->Widget()), panel);
}
