// Feeds arbitrary bytes to the database layer as a results store: the file is opened
// read-only, listed as the list page lists it, and must come out of it unchanged.
#include <unistd.h>

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "platform/core/database.h"

namespace {

void Require(bool condition) {
    if (!condition) {
        std::abort();
    }
}

std::string ReadAll(const std::filesystem::path& path) {
    std::ifstream in(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

// One store file for the whole run, in a folder of its own, rewritten for each input.
const std::filesystem::path& StoreFile() {
    static const std::filesystem::path file = [] {
        std::string pattern =
            (std::filesystem::temp_directory_path() / "store-fuzz-XXXXXX").string();
        Require(mkdtemp(pattern.data()) != nullptr);
        return std::filesystem::path(pattern) / "results.db";
    }();
    return file;
}

void List(SQLiteDatabase& db, const std::string& statement) {
    Ref<RecordSet> rows = db.SQLSelect(statement);
    for (int row = 0; rows && !rows->Eof() && row < 1000; ++row, rows->MoveNext()) {
        for (const char* column : {"id", "results", "datetime", "document", "grade"}) {
            if (Ref<DatabaseField> field = rows->Field(column)) {
                field->StringValue();
            }
        }
    }
    if (rows) {
        rows->Close();
    }
}

}  // namespace

// A store whose view never gives a row is given up after a tenth of a second, not 30.
extern "C" int LLVMFuzzerInitialize(int*, char***) {
    SQLiteDatabase::SetQuietLimitForTesting(std::chrono::milliseconds(100));
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::filesystem::path& file = StoreFile();
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    {
        std::ofstream out(file, std::ios::binary | std::ios::trunc);
        out << bytes;
    }
    {
        SQLiteDatabase db;
        db.DatabaseFile = GetFolderItem(file.string(), 3);
        if (db.Connect()) {
            List(db, "select * from results_store");
            List(db, "select * from results_store where id = '1'");
            List(db, "select name, sql from sqlite_master");
        }
        db.Close();
    }
    Require(ReadAll(file) == bytes);
    // Nothing beside the store but what SQLite's own locks in WAL mode need: its index and an
    // empty log. They go before the next input, whose store is another.
    for (const auto& entry : std::filesystem::directory_iterator(file.parent_path())) {
        const std::string name = entry.path().filename().string();
        Require(name == "results.db" || name == "results.db-shm" ||
                (name == "results.db-wal" && entry.file_size() == 0));
    }
    std::filesystem::remove(file.string() + "-shm");
    std::filesystem::remove(file.string() + "-wal");
    return 0;
}
