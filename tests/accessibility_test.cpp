// The window as a screen reader reads it, through Qt's accessibility interfaces: the segments
// as page tabs, the panes named by their tabs, and each report value with its caption.
#include <QAccessible>
#include <QPushButton>

#include "window_fixture.h"

using namespace testsupport;

namespace {

class AccessibilityTest : public WindowTest {
  protected:
    static QAccessibleInterface& Spoken(QWidget* widget) {
        QAccessibleInterface* spoken = QAccessible::queryAccessibleInterface(widget);
        EXPECT_NE(spoken, nullptr);
        return *spoken;
    }
    static std::string Name(QWidget* widget) {
        return Spoken(widget).text(QAccessible::Name).toStdString();
    }
};

TEST_F(AccessibilityTest, TheSegmentsArePageTabsOfWhichOneIsSelected) {
    auto window = StartUp();
    QWidget* row = window->MainTabs()->Widget();
    EXPECT_EQ(Spoken(row).role(), QAccessible::PageTabList);
    const auto segments = row->findChildren<QPushButton*>(Qt::FindDirectChildrenOnly);
    ASSERT_EQ(segments.size(), 2);
    for (int i = 0; i < 2; ++i) {
        QAccessibleInterface& tab = Spoken(segments[i]);
        EXPECT_EQ(tab.role(), QAccessible::PageTab);
        EXPECT_EQ(tab.parent()->role(), QAccessible::PageTabList);
        EXPECT_TRUE(tab.state().selectable);
        EXPECT_EQ(tab.state().selected, i == 1) << "the list page's tab";
        EXPECT_FALSE(tab.state().checkable);
    }
    EXPECT_EQ(Name(segments[0]), "Installation");
    EXPECT_EQ(Name(segments[1]), "Verification Results");

    // A screen reader presses a tab as a user clicks it.
    Spoken(segments[0]).actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(window->PagePanel1()->Value(), 0);
    EXPECT_TRUE(Spoken(segments[0]).state().selected);
    EXPECT_FALSE(Spoken(segments[1]).state().selected);
}

// Each value of the report is labelled by the caption at its height; the centred line has none.
TEST_F(AccessibilityTest, ThePanesAreNamedByTheirTabsAndEachValueByItsCaption) {
    auto window = StartUp({Result("1", "Box.ai")});
    ASSERT_TRUE(DoubleClickRow(window, 0));
    EXPECT_EQ(Name(window->TextArea1()->Widget()), "Measurements");
    EXPECT_TRUE(Spoken(window->TextArea1()->Widget()).state().readOnly) << "a text to read";
    window->TabPanel1()->SetValue(1);
    EXPECT_EQ(Name(window->TextArea2()->Widget()), "Deviances");

    const std::vector<std::pair<long long, long long>> captionOfValue = {
        {6, 7}, {0, 0}, {1, 1}, {2, 2}, {3, 3}, {4, 4}, {5, 5}, {7, 8}};
    for (const auto& [caption, value] : captionOfValue) {
        const auto labels = Spoken(window->Label6(value)->Widget()).relations(QAccessible::Label);
        ASSERT_EQ(labels.size(), 1) << "Label6(" << value << ")";
        EXPECT_EQ(labels.front().first->text(QAccessible::Name).toStdString(),
                  window->Label5(caption)->Text());
    }
    EXPECT_TRUE(Spoken(window->Label6(6)->Widget()).relations(QAccessible::Label).isEmpty());
}

}  // namespace
