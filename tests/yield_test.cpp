// The painting yield on the real window: the same list as an empty yield, rows on screen while
// the load runs, no handler but the cell paint inside it, input held back until the load ends.
#include <QHeaderView>
#include <QMouseEvent>
#include <QPushButton>

#include "platform/runtime/runtime.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

constexpr int kRows = 300;

class YieldTest : public WindowTest {
  protected:
    // From the installation page back to the list, which reloads it.
    void Reload(const Ref<class Window1>& window) {
        window->MainTabs()->Press(0);
        ProcessEvents();
        window->MainTabs()->Press(1);
    }

    // Every column of cells, the tags, then the selection, the page and the sort.
    std::vector<std::vector<std::string>> State(const Ref<class Window1>& window) {
        ProcessEvents();
        auto list = window->Listbox1();
        std::vector<std::vector<std::string>> state{
            Column(window, 0), Column(window, 1), Column(window, 2), Column(window, 3), {}};
        for (long long row = 0; row < list->ListCount(); ++row) {
            state.back().push_back(VariantToString(list->RowTag(row)));
        }
        state.push_back({std::to_string(list->ListIndex()),
                         std::to_string(window->PagePanel1()->Value()),
                         std::to_string(View(window).model()->rowCount()),
                         std::to_string(View(window).horizontalHeader()->sortIndicatorSection()),
                         std::to_string(View(window).horizontalHeader()->sortIndicatorOrder())});
        return state;
    }

    int cellPaints = 0;
    long long maxRowPainted = -1;
    std::vector<long long> rowsWhenPainted;
};

// Unsorted, then by the document up, then by the grade down: the heading clicked and how
// often, twice sorting descending. Documents and grades repeat, so a sort by them has to keep
// the order of equal rows.
TEST_F(YieldTest, APaintingLoadLeavesTheSameListAsAnEmptyYield) {
    Store(demo::InventedResults(kRows));
    auto window = StartUp();
    for (const auto& [column, clicks] : {std::pair{0, 0}, {1, 1}, {3, 2}}) {
        SCOPED_TRACE(::testing::Message() << "column " << column);
        SetYieldIntervalForTesting(std::chrono::nanoseconds::max());
        SetYieldPaintObserverForTesting(nullptr);
        for (int i = 0; i < clicks; ++i) {
            window->Listbox1()->PressHeading(column);
        }
        Reload(window);
        const auto empty = State(window);
        ASSERT_EQ(empty[4].size(), static_cast<size_t>(kRows));

        int paints = 0;
        SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
        SetYieldPaintObserverForTesting([&](auto) { ++paints; });
        Reload(window);
        EXPECT_GE(paints, kRows) << "a zero interval paints at every yield";
        EXPECT_EQ(State(window), empty);
    }
}

// Rows show before the load's loop ends, and no handler but the cell paint is entered inside
// it; a click queued during the load acts after it, once.
TEST_F(YieldTest, RowsShowDuringALoadAndAClickWaitsForItsEnd) {
    Store(demo::InventedResults(kRows));
    auto window = StartUp();
    window->MainTabs()->Press(0);
    ProcessEvents();
    // The cell paints inside yields, with the rows that the list had at that moment; kept in
    // the fixture, which outlives the window.
    auto list = window->Listbox1();
    list->CellBackgroundPaint = [this, handler = list->CellBackgroundPaint](
                                    Listbox& sender, Ref<Graphics> g, long long row,
                                    long long column) {
        if (YieldIsPainting()) {
            ++cellPaints;
            rowsWhenPainted.push_back(sender.ListCount());
            maxRowPainted = std::max(maxRowPainted, row);
        }
        return handler(sender, g, row, column);
    };
    int actions = 0;
    auto tabs = window->MainTabs();
    tabs->Action = [&actions, handler = tabs->Action](SegmentedControl& sender, long long index) {
        ++actions;
        handler(sender, index);
    };
    auto* installation = tabs->Widget()->findChildren<QPushButton*>().value(0);
    ASSERT_NE(installation, nullptr);
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    int paints = 0;
    SetYieldPaintObserverForTesting([&](auto) {
        if (++paints == 2) {
            const QPointF centre = installation->rect().center();
            const QPointF global = installation->mapToGlobal(centre);
            QCoreApplication::postEvent(installation,
                                        new QMouseEvent(QEvent::MouseButtonPress, centre, global,
                                                        Qt::LeftButton, Qt::LeftButton, {}));
            QCoreApplication::postEvent(installation,
                                        new QMouseEvent(QEvent::MouseButtonRelease, centre, global,
                                                        Qt::LeftButton, Qt::NoButton, {}));
        }
    });
    const long long before = HandlersEntered();
    window->MainTabs()->Press(1);
    ASSERT_GT(cellPaints, 0);
    EXPECT_EQ(rowsWhenPainted.front(), 1) << "the first row shows at the first yield";
    EXPECT_GT(maxRowPainted, 10) << "a screenful of rows";
    EXPECT_LT(cellPaints, kRows * 4 * 4) << "rows below the screen are not painted";
    const long long outside = 2;  // MainTabs_Action and PagePanel1_Change
    EXPECT_EQ(HandlersEntered() - before, outside + cellPaints);
    EXPECT_EQ(actions, 1) << "the press that loaded, and not yet the click";
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
    EXPECT_EQ(list->ListCount(), kRows);

    SetYieldPaintObserverForTesting(nullptr);
    ProcessEvents();
    EXPECT_EQ(actions, 2);
    EXPECT_EQ(window->PagePanel1()->Value(), 0);
}

}  // namespace
