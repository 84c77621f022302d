// The list page over stores that a hostile but realistic user leaves at the store's path, and
// reads that would not end by themselves: a store locked by a writer, a view without end, a view
// that never gives a row. The window repaints meanwhile, and each read ends in silence within a
// bound, with the store unchanged. And a store written during a load is
// listed as it stood when the load began.
#include <sys/stat.h>
#include <unistd.h>

#include <chrono>

#include "platform/core/database.h"
#include "platform/core/memory_bound.h"
#include "window_fixture.h"

using namespace testsupport;
namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock;

namespace {

constexpr auto kQuietLimit = std::chrono::milliseconds(500);
constexpr auto kLongestGap = std::chrono::milliseconds(200);

const std::string kEndlessView =
    "create view results_store as with recursive r(n) as (select 1 union all select n + 1 "
    "from r) select n as id, 'x' as datetime, hex(zeroblob(500)) as document, 'A' as grade, "
    "'Code reads ' || n as results from r";

size_t ResidentBytes() {
    size_t pages = 0, resident = 0;
    std::ifstream("/proc/self/statm") >> pages >> resident;
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

struct BadStore {
    friend void PrintTo(const BadStore& c, std::ostream* os) { *os << c.name; }
    const char* name;
    void (*make)(const fs::path& store);
    bool locked = false;  // another connection holds the store's exclusive lock meanwhile
    long long leastRows = 0, mostRows = 0;
};

class BadStoreTest : public LongReadTest, public ::testing::WithParamInterface<BadStore> {};

std::string Contents(const fs::path& store) {
    return fs::is_regular_file(store) ? ReadFile(store) : std::string();
}

TEST_P(BadStoreTest, TheListLoadsInSilenceWhileTheWindowRepaints) {
    const BadStore& load = GetParam();
    auto window = StartUp();  // without a store: an empty list
    window->MainTabs()->Press(0);
    fs::create_directories(store.parent_path());
    load.make(store);
    const std::string before = Contents(store);
    sqlite3* writer = nullptr;
    if (load.locked) {
        ASSERT_EQ(sqlite3_open(store.c_str(), &writer), SQLITE_OK);
        ASSERT_EQ(sqlite3_exec(writer, "begin exclusive", nullptr, nullptr, nullptr), SQLITE_OK);
    }
    MessageLog log;
    ::testing::internal::CaptureStderr();
    const auto [took, longestGap] = Watch([&] { window->MainTabs()->Press(1); });
    EXPECT_EQ(::testing::internal::GetCapturedStderr().find("Exception"), std::string::npos);
    sqlite3_close(writer);
    EXPECT_TRUE(log.messages.empty());
    EXPECT_LT(took, std::chrono::seconds(5));
    EXPECT_LE(longestGap, kLongestGap);
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
    EXPECT_GE(window->Listbox1()->ListCount(), load.leastRows);
    EXPECT_LE(window->Listbox1()->ListCount(), load.mostRows);
    EXPECT_EQ(Contents(store), before);
    EXPECT_FALSE(fs::exists(store.string() + "-journal"));
}

void MakeCorrupt(const fs::path& store) {
    demo::WriteStore(store, demo::InventedResults(200));
    // Page 2 onwards, where the table's rows lie, overwritten with noise.
    std::string bytes = ReadFile(store);
    for (size_t i = 4096; i < bytes.size(); i += 7) {
        bytes[i] = static_cast<char>(i * 31);
    }
    std::ofstream(store, std::ios::binary) << bytes;
}

INSTANTIATE_TEST_SUITE_P(
    Stores, BadStoreTest,
    ::testing::Values(
        BadStore{"NoFile", [](const fs::path&) {}},
        BadStore{"EmptyTable", [](const fs::path& p) { demo::WriteStore(p, {}); }},
        BadStore{"Folder", [](const fs::path& p) { fs::create_directory(p); }},
        BadStore{"ZeroBytes", [](const fs::path& p) { WriteFile(p, ""); }},
        BadStore{"Corrupt", MakeCorrupt},
        BadStore{"MissingTable",
                 [](const fs::path& p) { demo::WriteStore(p, {}, "create table t (id text)"); }},
        BadStore{"LinkToNothing",
                 [](const fs::path& p) { fs::create_symlink(p.string() + ".gone", p); }},
        // open() of a FIFO would wait for a writer for ever, so it is refused before it is
        // opened, behind a link too.
        BadStore{"Fifo", [](const fs::path& p) { ASSERT_EQ(mkfifo(p.c_str(), 0600), 0); }},
        BadStore{"LinkToAFifo",
                 [](const fs::path& p) {
                     ASSERT_EQ(mkfifo((p.string() + ".fifo").c_str(), 0600), 0);
                     fs::create_symlink(p.string() + ".fifo", p);
                 }},
        // The lock is waited for as long as the bound, and the list stays as it was.
        BadStore{"LockedByAWriter", [](const fs::path& p) { demo::WriteStore(p, {}); }, true},
        // Rows until the process's memory passes its bound; those read so far stay.
        BadStore{"EndlessView", [](const fs::path& p) { ExecSql(p, kEndlessView); }, false, 1000,
                 1 << 30},
        // No row ever: the statement is ended once it has given none for the quiet limit.
        BadStore{"ViewThatNeverGivesARow",
                 [](const fs::path& p) { ExecSql(p, kEndlessView + " where n < 0"); }}),
    [](const auto& info) { return std::string(info.param.name); });

// The plug-in keeps its store in WAL mode and changes the first and the last row in one
// transaction, then moves its log into the store, while the list loads: the list shows the
// store as it stood when the load began, and the next load shows the change.
TEST_F(LongReadTest, AStoreWrittenDuringTheLoadIsListedAsItWasWhenTheLoadBegan) {
    Store(demo::InventedResults(300, false));
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
    EXPECT_NE(documents.front(), "New.ai");
    EXPECT_NE(documents.back(), "New.ai");
    window->MainTabs()->Press(0);
    window->MainTabs()->Press(1);
    documents = Column(window, 1);
    EXPECT_EQ(documents.front() + " " + documents.back(), "New.ai New.ai");
}

}  // namespace
