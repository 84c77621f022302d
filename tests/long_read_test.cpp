// Reads that would not end by themselves, on the real window: a store locked by a writer, a
// view without end, a view that never gives a row, an id that never ends. The window repaints
// meanwhile, and each read ends in silence within a bound. And a store written during a load
// is listed as it stood when the load began.
#include <unistd.h>

#include <chrono>
#include <cstdio>

#include "platform/core/database.h"
#include "platform/core/memory_bound.h"
#include "platform/runtime/yield.h"
#include "window_fixture.h"

using namespace testsupport;
namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock;

namespace {

constexpr auto kQuietLimit = std::chrono::milliseconds(500);
constexpr auto kLongestGap = std::chrono::milliseconds(200);

const std::string kEndless = "with recursive r(n) as (select 1 union all select n + 1 from r) ";
const std::string kEndlessView = "create view results_store as " + kEndless +
                                 "select n as id, 'x' as datetime, hex(zeroblob(500)) as "
                                 "document, 'A' as grade, 'Code reads ' || n as results from r";

size_t ResidentBytes() {
    size_t pages = 0;
    size_t resident = 0;
    if (std::FILE* statm = std::fopen("/proc/self/statm", "r")) {
        EXPECT_EQ(std::fscanf(statm, "%zu %zu", &pages, &resident), 2);
        std::fclose(statm);
    }
    return resident * static_cast<size_t>(sysconf(_SC_PAGESIZE));
}

class LongReadTest : public WindowTest {
  protected:
    void SetUp() override {
        SQLiteDatabase::SetQuietLimitForTesting(
            std::chrono::duration_cast<std::chrono::milliseconds>(kQuietLimit));
        SetMemoryBoundForTesting(ResidentBytes() + (size_t{64} << 20));
        SetYieldPaintObserverForTesting([this](auto) { Painted(); });
    }
    void TearDown() override {
        SQLiteDatabase::SetQuietLimitForTesting(std::chrono::seconds(30));
        SetMemoryBoundForTesting(0);
        SetYieldPaintObserverForTesting(nullptr);
        SetYieldIntervalForTesting(std::chrono::milliseconds(50));
        WindowTest::TearDown();
    }

    // Runs `action`, and gives its time and the longest time in it without a repaint.
    template <class F>
    std::pair<Clock::duration, Clock::duration> Watch(F&& action) {
        start_ = lastPaint_ = Clock::now();
        longestGap_ = {};
        action();
        Painted();
        return {lastPaint_ - start_, longestGap_};
    }
    void Painted() {
        const auto now = Clock::now();
        longestGap_ = std::max(longestGap_, now - lastPaint_);
        lastPaint_ = now;
    }

    fs::path store = demo::StorePath(tree.Path());

  private:
    Clock::time_point start_, lastPaint_;
    Clock::duration longestGap_{};
};

struct LongLoad {
    const char* name;
    std::string schema;  // run on a fresh store, as the plug-in would
    bool locked;         // another connection holds the store's exclusive lock meanwhile
    long long leastRows, mostRows;
};
void PrintTo(const LongLoad& load, std::ostream* out) {
    *out << load.name;
}

class LongLoadTest : public LongReadTest, public ::testing::WithParamInterface<LongLoad> {};

TEST_P(LongLoadTest, EndsInSilenceWhileTheWindowRepaints) {
    const LongLoad& load = GetParam();
    auto window = StartUp();  // without a store: an empty list
    window->MainTabs()->Press(0);
    WriteFile(store, "");
    ExecSql(store, load.schema);
    const std::string before = ReadFile(store);
    sqlite3* writer = nullptr;
    if (load.locked) {
        ASSERT_EQ(sqlite3_open(store.c_str(), &writer), SQLITE_OK);
        ASSERT_EQ(sqlite3_exec(writer, "begin exclusive", nullptr, nullptr, nullptr), SQLITE_OK);
    }
    ::testing::internal::CaptureStderr();
    const auto [took, longestGap] = Watch([&] { window->MainTabs()->Press(1); });
    EXPECT_EQ(::testing::internal::GetCapturedStderr().find("Exception"), std::string::npos);
    sqlite3_close(writer);
    EXPECT_LT(took, std::chrono::seconds(5));
    EXPECT_LE(longestGap, kLongestGap);
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
    EXPECT_GE(window->Listbox1()->ListCount(), load.leastRows);
    EXPECT_LE(window->Listbox1()->ListCount(), load.mostRows);
    EXPECT_EQ(ReadFile(store), before);
}

INSTANTIATE_TEST_SUITE_P(
    Stores, LongLoadTest,
    ::testing::Values(
        // The lock is waited for as long as the bound, and the list stays as it was.
        LongLoad{"LockedByAWriter", demo::kSchema, true, 0, 0},
        // Rows until the process's memory passes its bound; those read so far stay.
        LongLoad{"EndlessView", kEndlessView, false, 1000, 1 << 30},
        // No row ever: the statement is ended once it has given none for the quiet limit.
        LongLoad{"ViewThatNeverGivesARow", kEndlessView + " where n < 0", false, 0, 0}),
    [](const auto& info) { return std::string(info.param.name); });

// The row query joins the id in as it stands, so an id can hold a query without end: the double
// click shows no report.
TEST_F(LongReadTest, ADoubleClickOnAnIdThatNeverEndsShowsNoReport) {
    const std::string endlessId = "' or id in (" + kEndless + "select 'x' from r where n < 0) --";
    Store({Result("1", "Box.ai"), {endlessId, "2018", "Endless.ai", "A", "Code reads 2"}});
    auto window = StartUp();
    ASSERT_EQ(window->Listbox1()->ListCount(), 2);
    const auto [took, longestGap] = Watch([&] { DoubleClickRow(window, 1); });
    EXPECT_GE(took, kQuietLimit);
    EXPECT_LT(took, std::chrono::seconds(5));
    EXPECT_LE(longestGap, kLongestGap);
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
}

// The plug-in keeps its store in WAL mode and changes the first and the last row in one
// transaction, then moves its log into the store, while the list loads: the list shows the
// store as it stood when the load began, and the next load shows the change.
TEST_F(LongReadTest, AStoreWrittenDuringTheLoadIsListedAsItWasWhenTheLoadBegan) {
    std::vector<demo::StoredResult> rows;
    for (int i = 1; i <= 300; ++i) {
        rows.push_back(Result(std::to_string(i), "Old.ai"));
    }
    Store(rows);
    ExecSql(store, "pragma journal_mode=wal");
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    int paints = 0;
    SetYieldPaintObserverForTesting([&](auto) {
        if (++paints == 100) {
            ExecSql(store,
                    "update results_store set document = 'New.ai' where id in ('1', '300');"
                    "pragma wal_checkpoint");
        }
    });
    auto window = StartUp();
    ASSERT_GT(paints, 100);
    auto documents = Column(window, 1);
    ASSERT_EQ(documents.size(), 300u);
    EXPECT_EQ(documents.front() + " " + documents.back(), "Old.ai Old.ai");
    window->MainTabs()->Press(0);
    window->MainTabs()->Press(1);
    documents = Column(window, 1);
    EXPECT_EQ(documents.front() + " " + documents.back(), "New.ai New.ai");
}

}  // namespace
