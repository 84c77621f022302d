// The real window without a mouse. Driven by the keyboard: the list's keys and its focus, the
// pages' focus, Tab to the segments, Copy of a row. Read by a screen reader, through Qt's
// accessibility interfaces: the segments as page tabs, the panes named by their tabs, and each
// report value with its caption.
#include <QAbstractScrollArea>
#include <QAccessible>
#include <QClipboard>
#include <QMenu>
#include <QPushButton>

#include "contrast.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

using KeyboardTest = WindowTest;

// The focused list rings its current row without choosing it, and the first Down chooses that
// row. End selects the last row; Copy puts the heading line and that row on the clipboard, and
// Return opens its report. A page that comes into view takes the focus at its first control in
// the keyboard order when the focus would go out of view with the page before; a text pane
// rings itself while focused. Tab leaves the list for the segments, where Space chooses a page
// and the focus stays.
TEST_F(KeyboardTest, ThroughThePagesByKeys) {
    auto window =
        StartUp({Result("1", "Box.ai"), Result("2", "Jar.ai"), Result("3", "Tin\tlid.ai")});
    QApplication::setActiveWindow(window->Native());
    ASSERT_EQ(QApplication::focusWidget(), &View(window)) << "the list page, at start";
    const auto press = [](Qt::Key key, Qt::KeyboardModifiers modifiers = {}) {
        ASSERT_NE(QApplication::focusWidget(), nullptr);
        QTest::keyClick(QApplication::focusWidget(), key, modifiers);
        ProcessEvents();
    };
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
    press(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QApplication::clipboard()->text(), "before");
    press(Qt::Key_Return);
    EXPECT_EQ(window->PagePanel1()->Value(), 1) << "no row selected, nothing to open";
    QWidget* rows = View(window).viewport();
    EXPECT_GE(Contrast(Pixel(rows, 2, 12), Pixel(rows, 120, 12)), 4.5) << "the row is ringed";
    press(Qt::Key_Down);
    EXPECT_EQ(window->Listbox1()->ListIndex(), 0) << "the first Down chooses the ringed row";

    press(Qt::Key_End);
    ASSERT_EQ(window->Listbox1()->ListIndex(), 2);
    EXPECT_TRUE(offered());
    press(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QApplication::clipboard()->text().toStdString(),
              "Date - Time\tDocument\tRead Value\tGrade\n2018-11-03\tTin lid.ai\t 3\tA\n");
    press(Qt::Key_Return);
    EXPECT_EQ(window->PagePanel1()->Value(), 2);
    EXPECT_EQ(window->Label6(7)->Text(), "Tin\tlid.ai");

    EXPECT_EQ(QApplication::focusWidget(), window->PushButton2()->Widget());
    auto* pane = static_cast<QAbstractScrollArea*>(window->TextArea1()->Widget());
    const QRgb ground = Pixel(pane->viewport(), 1, 1);
    press(Qt::Key_Tab);
    press(Qt::Key_Tab);
    ASSERT_EQ(QApplication::focusWidget(), pane);
    EXPECT_GE(Contrast(Pixel(pane->viewport(), 1, 1), ground), 4.5) << "the pane is ringed";
    window->PushButton2()->Push();
    ASSERT_EQ(QApplication::focusWidget(), &View(window));

    press(Qt::Key_Tab);
    ASSERT_TRUE(window->MainTabs()->Widget()->isAncestorOf(QApplication::focusWidget()))
        << "Tab reaches a segment";
    EXPECT_EQ(static_cast<QPushButton*>(QApplication::focusWidget())->text(), "Installation");
    press(Qt::Key_Space);
    EXPECT_EQ(window->PagePanel1()->Value(), 0);
    EXPECT_EQ(static_cast<QPushButton*>(QApplication::focusWidget())->text(), "Installation")
        << "the focus stays on the segments that chose the page";
    window->MainTabs()->Press(1);
    View(window).setFocus();
    window->MainTabs()->Press(0);
    EXPECT_EQ(QApplication::focusWidget(), window->PushButton1()->Widget());
}

using AccessibilityTest = WindowTest;

// The segments are page tabs of which one is selected, and a screen reader presses a tab as a
// user clicks it. The panes are named by their tabs, and a value of the report is labelled by
// the caption at its height, the document's below the centred line, which has none.
TEST_F(AccessibilityTest, TheSegmentsThePanesAndTheValuesAreSpoken) {
    const auto spoken = [](QWidget* widget) -> QAccessibleInterface& {
        QAccessibleInterface* found = QAccessible::queryAccessibleInterface(widget);
        EXPECT_NE(found, nullptr);
        return *found;
    };
    const auto name = [&](QWidget* widget) {
        return spoken(widget).text(QAccessible::Name).toStdString();
    };
    auto window = StartUp({Result("1", "Box.ai")});
    QWidget* row = window->MainTabs()->Widget();
    EXPECT_EQ(spoken(row).role(), QAccessible::PageTabList);
    const auto segments = row->findChildren<QPushButton*>(Qt::FindDirectChildrenOnly);
    ASSERT_EQ(segments.size(), 2);
    for (int i = 0; i < 2; ++i) {
        QAccessibleInterface& tab = spoken(segments[i]);
        EXPECT_EQ(tab.role(), QAccessible::PageTab);
        EXPECT_EQ(tab.parent()->role(), QAccessible::PageTabList);
        EXPECT_TRUE(tab.state().selectable);
        EXPECT_EQ(tab.state().selected, i == 1) << "the list page's tab";
        EXPECT_FALSE(tab.state().checkable);
    }
    EXPECT_EQ(name(segments[0]), "Installation");
    EXPECT_EQ(name(segments[1]), "Verification Results");

    ASSERT_TRUE(DoubleClickRow(window, 0));
    EXPECT_EQ(name(window->TextArea1()->Widget()), "Measurements");
    EXPECT_TRUE(spoken(window->TextArea1()->Widget()).state().readOnly) << "a text to read";
    window->TabPanel1()->SetValue(1);
    EXPECT_EQ(name(window->TextArea2()->Widget()), "Deviances");
    const auto labels = spoken(window->Label6(7)->Widget()).relations(QAccessible::Label);
    ASSERT_EQ(labels.size(), 1);
    EXPECT_EQ(labels.front().first->text(QAccessible::Name).toStdString(),
              window->Label5(6)->Text());
    EXPECT_TRUE(spoken(window->Label6(6)->Widget()).relations(QAccessible::Label).isEmpty());

    spoken(segments[0]).actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(window->PagePanel1()->Value(), 0);
    EXPECT_TRUE(spoken(segments[0]).state().selected);
    EXPECT_FALSE(spoken(segments[1]).state().selected);
}

}  // namespace
