// The painting yield on the real window: the same list as an empty yield, rows on screen while
// the load runs, no handler but the cell paint inside it, input held back until the load ends.
#include <QHeaderView>
#include <QMouseEvent>
#include <QPushButton>

#include "installer/copy.h"
#include "platform/runtime.h"
#include "platform/yield.h"
#include "shell/startup.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

constexpr int kRows = 300;

// The grades repeat, so a sort by them has to keep the order of equal rows.
std::vector<demo::StoredResult> Results(int count) {
    std::vector<demo::StoredResult> rows;
    for (int i = 1; i <= count; ++i) {
        const std::string n = std::to_string(i);
        rows.push_back({n, "2018-11-" + n, "Doc " + std::to_string(i * 7919 % count) + ".ai",
                        std::string(1, static_cast<char>('A' + i % 4)),
                        "Code reads " + n + "\rCode is EAN 13"});
    }
    return rows;
}

// Everything that a load leaves behind, as the user and the logic meet it.
struct ListState {
    std::vector<std::vector<std::string>> rows;  // four cells and the tag of each row
    long long listIndex = 0;
    long long page = 0;
    long long sortColumn = 0;
    bool sortDescending = false;
    int viewRows = 0;
    bool operator==(const ListState&) const = default;
};

class YieldTest : public WindowTest {
  protected:
    void TearDown() override {
        SetYieldIntervalForTesting(std::chrono::milliseconds(50));
        SetYieldClockForTesting(nullptr);
        SetYieldPaintObserverForTesting(nullptr);
        WindowTest::TearDown();
    }

    // From the installation page back to the list, which reloads it.
    void Reload(const Ref<class Window1>& window) {
        window->MainTabs()->Press(0);
        ProcessEvents();
        window->MainTabs()->Press(1);
    }

    ListState State(const Ref<class Window1>& window) {
        ProcessEvents();
        ListState state;
        auto list = window->Listbox1();
        for (long long row = 0; row < list->ListCount(); ++row) {
            std::vector<std::string> cells;
            for (int column = 0; column < 4; ++column) {
                cells.push_back(list->Cell(row, column));
            }
            cells.push_back(VariantToString(list->RowTag(row)));
            state.rows.push_back(cells);
        }
        state.listIndex = list->ListIndex();
        state.page = window->PagePanel1()->Value();
        state.sortColumn = View(window).horizontalHeader()->sortIndicatorSection();
        state.sortDescending =
            View(window).horizontalHeader()->sortIndicatorOrder() == Qt::DescendingOrder;
        state.viewRows = View(window).model()->rowCount();
        return state;
    }

    // Counts the cell paints inside yields, with the rows that the list had at that moment.
    void CountCellPaints(const Ref<class Window1>& window) {
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
    }

    int cellPaints = 0;
    long long maxRowPainted = -1;
    std::vector<long long> rowsWhenPainted;
};

// 0: no sort; otherwise the column + 1 whose heading was clicked, twice for a descending sort.
class SameListTest : public YieldTest, public ::testing::WithParamInterface<std::pair<int, int>> {};

TEST_P(SameListTest, APaintingLoadLeavesTheSameListAsAnEmptyYield) {
    const auto [column, clicks] = GetParam();
    Store(Results(kRows));
    SetYieldIntervalForTesting(std::chrono::nanoseconds::max());
    auto window = StartUp();
    for (int i = 0; i < clicks; ++i) {
        window->Listbox1()->PressHeading(column);
    }
    Reload(window);
    const ListState empty = State(window);
    ASSERT_EQ(empty.rows.size(), static_cast<size_t>(kRows));

    int paints = 0;
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    SetYieldPaintObserverForTesting([&](auto) { ++paints; });
    Reload(window);
    EXPECT_EQ(paints, kRows) << "a zero interval paints at every yield";
    EXPECT_EQ(State(window), empty);
}

INSTANTIATE_TEST_SUITE_P(Sorts, SameListTest,
                         ::testing::Values(std::pair{0, 0}, std::pair{1, 1}, std::pair{3, 2}),
                         [](const auto& info) {
                             return info.param.second == 0   ? std::string("Unsorted")
                                    : info.param.second == 1 ? std::string("ByDocumentUp")
                                                             : std::string("ByGradeDown");
                         });

TEST_F(YieldTest, RowsAreOnScreenBeforeTheLoopEnds) {
    Store(Results(kRows));
    auto window = StartUp();
    CountCellPaints(window);
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    Reload(window);
    ASSERT_GT(cellPaints, 0);
    EXPECT_EQ(rowsWhenPainted.front(), 1) << "the first row shows at the first yield";
    EXPECT_LT(*std::max_element(rowsWhenPainted.begin(), rowsWhenPainted.end()), kRows + 1);
    EXPECT_GT(maxRowPainted, 10) << "a screenful of rows";
    EXPECT_LT(cellPaints, kRows * 4 * 4) << "rows below the screen are not painted";
}

TEST_F(YieldTest, WithASortTheFirstScreenWaitsForTheSort) {
    Store(Results(kRows));
    auto window = StartUp();
    window->Listbox1()->PressHeading(1);
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    std::vector<int> viewRows;
    SetYieldPaintObserverForTesting(
        [&](auto) { viewRows.push_back(View(window).model()->rowCount()); });
    Reload(window);
    ASSERT_EQ(viewRows.size(), static_cast<size_t>(kRows));
    EXPECT_EQ(viewRows.back(), 0);
    ProcessEvents();
    EXPECT_EQ(View(window).model()->rowCount(), kRows);
}

TEST_F(YieldTest, NoHandlerButTheCellPaintIsEnteredInsideTheYield) {
    Store(Results(kRows));
    auto window = StartUp();
    window->MainTabs()->Press(0);
    ProcessEvents();
    CountCellPaints(window);
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    int paints = 0;
    SetYieldPaintObserverForTesting([&](auto) { ++paints; });
    const long long before = HandlersEntered();
    // The list page comes with its frame, which needs painting inside the first yield.
    window->MainTabs()->Press(1);
    const long long outside = 2;  // MainTabs_Action and PagePanel1_Change
    EXPECT_EQ(paints, kRows);
    EXPECT_GT(cellPaints, 0);
    EXPECT_EQ(HandlersEntered() - before, outside + cellPaints);

    const long long afterLoad = HandlersEntered();
    ProcessEvents();
    EXPECT_GT(HandlersEntered(), afterLoad) << "the frame is painted once the loop is free";
}

TEST_F(YieldTest, TheCopyPaintsAtEachPassAndEntersNoHandler) {
    Store(Results(kRows));
    auto window = StartUp();
    const auto source = tree.Path() / "Ostrelin.acroplugin";
    for (int folder = 0; folder < 3; ++folder) {
        for (int file = 0; file < 5; ++file) {
            WriteFile(source / std::to_string(folder) / std::to_string(file), "plug-in");
        }
    }
    std::filesystem::create_directories(tree.Path() / "Plug-ins");
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    int paints = 0;
    SetYieldPaintObserverForTesting([&](auto) { ++paints; });
    const long long before = HandlersEntered();
    CopyFileOrFolder(GetFolderItem(source.string(), 3),
                     GetFolderItem((tree.Path() / "Plug-ins").string(), 3));
    EXPECT_EQ(paints, 3 + 3 * 5) << "one yield per child of every folder";
    EXPECT_EQ(HandlersEntered(), before);
    EXPECT_EQ(ReadFile(tree.Path() / "Plug-ins" / "Ostrelin.acroplugin" / "2" / "4"), "plug-in");
}

TEST_F(YieldTest, TheStartUpLoadWaitsForTheWindowAndPaintsItsRows) {
    Store(Results(kRows));
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    std::vector<int> viewRows;
    SetYieldPaintObserverForTesting([&](auto) {
        auto window = Cast<class Window1>(_GetImplicitWindow("Window1.Window1"));
        viewRows.push_back(View(window).model()->rowCount());
    });
    // The real _Main, with its event loop ended once the list is loaded.
    QTimer poll;
    QObject::connect(&poll, &QTimer::timeout, [] {
        auto window = _GetImplicitWindow("Window1.Window1");
        if (window && Cast<class Window1>(window)->Listbox1()->ListCount() == kRows) {
            QCoreApplication::exit(0);
        }
    });
    poll.start(10);
    QTimer::singleShot(5000, [] { QCoreApplication::exit(1); });
    _Main();
    ASSERT_EQ(viewRows.size(), static_cast<size_t>(kRows)) << "every yield of the load painted";
    EXPECT_EQ(viewRows.front(), 1);
}

// A clock that moves 10 ms at each reading.
std::chrono::nanoseconds fakeNow{0};
std::chrono::nanoseconds TenMillisecondsAStep() {
    fakeNow += std::chrono::milliseconds(10);
    return fakeNow;
}

TEST_F(YieldTest, TheYieldPaintsAtMostEveryFiftyMilliseconds) {
    Store(Results(kRows));
    auto window = StartUp();
    SetYieldClockForTesting(&TenMillisecondsAStep);
    int paints = 0;
    SetYieldPaintObserverForTesting([&](auto) { ++paints; });
    window->PagePanel1()->SetValue(1);
    EXPECT_EQ(paints, kRows / 5);
}

TEST_F(YieldTest, AClickQueuedDuringALoadActsAfterItOnce) {
    Store(Results(kRows));
    auto window = StartUp();
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
    std::vector<long long> pagesSeen;
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
        pagesSeen.push_back(window->PagePanel1()->Value());
    });
    window->PagePanel1()->SetValue(1);
    EXPECT_EQ(paints, kRows);
    EXPECT_EQ(actions, 0);
    EXPECT_EQ(std::count(pagesSeen.begin(), pagesSeen.end(), 1), kRows);
    EXPECT_EQ(window->Listbox1()->ListCount(), kRows);

    SetYieldPaintObserverForTesting(nullptr);
    ProcessEvents();
    EXPECT_EQ(actions, 1);
    EXPECT_EQ(window->PagePanel1()->Value(), 0);
}

}  // namespace
