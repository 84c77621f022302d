// The list page over stores that a hostile but realistic user leaves at the store's path: each
// ends in silence, within a bound, with the store unchanged.
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <chrono>
#include <future>

#include "platform/core/database.h"
#include "window_fixture.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

struct HostileStore {
    const char* name;
    void (*make)(const fs::path& store);
    std::vector<std::string> documents;  // what the list shows afterwards
};
void PrintTo(const HostileStore& store, std::ostream* out) {
    *out << store.name;
}

class HostileStoreTest : public WindowTest, public ::testing::WithParamInterface<HostileStore> {};

std::string Contents(const fs::path& store) {
    return fs::is_regular_file(store) ? ReadFile(store) : std::string();
}

TEST_P(HostileStoreTest, TheListLoadsInSilenceAndTheStoreIsUnchanged) {
    const fs::path store = demo::StorePath(tree.Path());
    fs::create_directories(store.parent_path());
    GetParam().make(store);
    const std::string before = Contents(store);
    const auto start = std::chrono::steady_clock::now();
    MessageLog log;
    ::testing::internal::CaptureStderr();
    auto window = StartUp();
    EXPECT_EQ(::testing::internal::GetCapturedStderr().find("Exception"), std::string::npos);
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::seconds(5));
    EXPECT_TRUE(log.messages.empty());
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
    EXPECT_EQ(Column(window, 1), GetParam().documents);
    EXPECT_EQ(Contents(store), before);
    EXPECT_EQ(fs::exists(store.string() + "-journal"), false);
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
    Stores, HostileStoreTest,
    ::testing::Values(
        HostileStore{"NoFile", [](const fs::path&) {}, {}},
        HostileStore{"EmptyTable", [](const fs::path& p) { demo::WriteStore(p, {}); }, {}},
        HostileStore{"Folder", [](const fs::path& p) { fs::create_directory(p); }, {}},
        HostileStore{"ZeroBytes", [](const fs::path& p) { WriteFile(p, ""); }, {}},
        HostileStore{"Corrupt", MakeCorrupt, {}},
        HostileStore{"MissingTable",
                     [](const fs::path& p) { demo::WriteStore(p, {}, "create table t (id text)"); },
                     {}},
        HostileStore{"LinkToNothing",
                     [](const fs::path& p) { fs::create_symlink(p.string() + ".gone", p); },
                     {}},
        HostileStore{"ReorderedColumns",
                     [](const fs::path& p) {
                         demo::WriteStore(p, {Result("1", "Box.ai"), Result("2", "Jar.ai")},
                                          "create table results_store (results text, extra int, "
                                          "grade text, document text, id text, datetime text)");
                     },
                     {"Box.ai", "Jar.ai"}}),
    [](const auto& info) { return std::string(info.param.name); });

using FifoStoreTest = WindowTest;

// open() of a FIFO waits for a writer for ever, so the read runs aside; if it is still waiting
// after the bound, a writer is opened to release it and the test fails.
TEST_F(FifoStoreTest, IsRefusedBeforeItIsOpened) {
    const fs::path store = demo::StorePath(tree.Path());
    fs::create_directories(store.parent_path());
    ASSERT_EQ(mkfifo(store.c_str(), 0600), 0);
    fs::create_symlink(store, tree.Path() / "link.db");
    for (const fs::path& path : {store, tree.Path() / "link.db"}) {
        auto connected = std::async(std::launch::async, [&path] {
            SQLiteDatabase db;
            db.DatabaseFile = GetFolderItem(path.string(), 3);
            const bool result = db.Connect();
            db.Close();
            return result;
        });
        if (connected.wait_for(std::chrono::seconds(5)) != std::future_status::ready) {
            const int writer = open(store.c_str(), O_WRONLY | O_NONBLOCK);
            ADD_FAILURE() << "Connect waited on the FIFO " << path;
            connected.wait();
            close(writer);
            continue;
        }
        EXPECT_FALSE(connected.get()) << path;
    }
    if (HasFailure()) {
        return;
    }
    auto window = StartUp();
    EXPECT_EQ(window->Listbox1()->ListCount(), 0);
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
}

}  // namespace
