// The read side of the results store on real SQLite files: a WAL store, fields that outlive
// their row, hostile ids, and a store that is never written. Stores that end the read early are
// met on the window in hostile_store_test.
#include <set>

#include "demo/demo_tree.h"
#include "results/results_store.h"
#include "support.h"

using namespace testsupport;

namespace {

class StoreTest : public RootedTest {
  protected:
    int Rows(const std::string& statement) {
        SQLiteDatabase db;
        auto rows = OpenStore(db, statement);
        int count = 0;
        for (; rows && !rows->Eof(); rows->MoveNext()) {
            ++count;
        }
        db.Close();
        return count;
    }
    std::filesystem::path store = demo::StorePath(tree.Path());
};

// A store that the plug-in keeps in WAL mode is read under SQLite's locks, kept in a -shm file
// that SQLite puts beside it with an empty -wal; the store itself is never written. Read while
// the writer has it open, the rows in the writer's log count too.
TEST_F(StoreTest, AStoreInWalModeIsReadWithoutWritingIt) {
    demo::WriteStore(store, demo::InventedResults(3));
    ExecSql(store, "pragma journal_mode=wal");
    const std::string before = ReadFile(store);
    EXPECT_EQ(Rows(kListQuery), 3);
    EXPECT_EQ(ReadFile(store), before);
    std::set<std::string> beside;
    for (const auto& entry : std::filesystem::directory_iterator(store.parent_path())) {
        beside.insert(entry.path().filename().string());
    }
    EXPECT_EQ(beside, (std::set<std::string>{"results.db", "results.db-shm", "results.db-wal"}));
    EXPECT_EQ(std::filesystem::file_size(store.string() + "-wal"), 0u);

    sqlite3* writer = nullptr;
    ASSERT_EQ(sqlite3_open(store.c_str(), &writer), SQLITE_OK);
    ASSERT_EQ(sqlite3_exec(writer, "insert into results_store (id) values ('new')", nullptr,
                           nullptr, nullptr),
              SQLITE_OK);
    EXPECT_EQ(Rows(kListQuery), 4);
    sqlite3_close(writer);
}

// A field is a view of its row until the cursor moves; one still held keeps its own text. A
// record set outlives its database.
TEST_F(StoreTest, FieldsAndRecordSetsOutliveWhatTheyCameFrom) {
    demo::WriteStore(store, demo::InventedResults(3, false));
    Ref<RecordSet> rows;
    {
        SQLiteDatabase db;
        rows = OpenStore(db, kListQuery);
        db.Close();
    }
    ASSERT_FALSE(rows.IsNil());
    const Ref<DatabaseField> first = rows->Field("id");
    const Ref<DatabaseField> again = rows->Field("id");
    const Ref<DatabaseField> document = rows->Field("document");
    const std::string firstDocument = *document;
    rows->MoveNext();
    EXPECT_EQ(rows->Field("id")->StringValue(), "2");
    EXPECT_EQ(first->StringValue() + again->StringValue(), "11");
    rows->Close();
    EXPECT_EQ(std::string(*document), firstDocument);
}

TEST_F(StoreTest, HostileIdsEndTheReadAndRunNothingElse) {
    demo::WriteStore(store, demo::InventedResults(5, false));
    const std::string before = ReadFile(store);
    EXPECT_EQ(Rows(RowQuery("it's")), 0);
    EXPECT_EQ(Rows(RowQuery("x'; delete from results_store; --")), 0);
    EXPECT_EQ(Rows(RowQuery("x' or '1'='1")), 5) << "a condition in the id is still one statement";
    EXPECT_EQ(Rows(RowQuery("3")), 1);
    EXPECT_EQ(Rows(kListQuery), 5);
    EXPECT_EQ(ReadFile(store), before);
}

TEST_F(StoreTest, SQLSelectRunsExactlyOneReadingStatement) {
    demo::WriteStore(store, demo::InventedResults(2, false));
    SQLiteDatabase db;
    db.DatabaseFile = GetFolderItem(kResultsStorePath, 1);
    ASSERT_TRUE(db.Connect());
    EXPECT_FALSE(db.SQLSelect("select * from results_store;  -- the list\n").IsNil());
    EXPECT_TRUE(db.SQLSelect("select * from results_store; select 1").IsNil());
    EXPECT_TRUE(db.SQLSelect("delete from results_store").IsNil()) << "the connection reads only";
    db.Close();
    EXPECT_TRUE(db.SQLSelect(kListQuery).IsNil());
}

}  // namespace
