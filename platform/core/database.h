// SQLiteDatabase, RecordSet and DatabaseField: reading one SQLite file. The connection is
// read-only and never creates a file; a record set steps its cursor as the caller moves and
// never holds the whole result.
#pragma once

#include <chrono>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "platform/core/folder_item.h"
#include "platform/core/ref.h"

struct sqlite3;
struct sqlite3_stmt;

class DatabaseField {
  public:
    DatabaseField() = default;
    DatabaseField(const DatabaseField&) = delete;
    DatabaseField& operator=(const DatabaseField&) = delete;

    // The column's value as text; a NULL is the empty text.
    std::string StringValue() const { return std::string(value_); }
    operator std::string() const { return StringValue(); }
    operator std::string_view() const { return value_; }

    // Platform use: the field shows the current row's text until Keep gives it its own copy.
    void Show(std::string_view text) { value_ = text; }
    void Keep() {
        kept_ = value_;
        value_ = kept_;
    }

  private:
    std::string kept_;
    std::string_view value_;
};

// The SQLite objects, each released by its own call when its owner goes.
struct FinalizeStatement {
    void operator()(sqlite3_stmt* statement) const;
};
using StatementPtr = std::unique_ptr<sqlite3_stmt, FinalizeStatement>;
// A connection closed while statements are left stays open for them until they go.
struct CloseConnection {
    void operator()(sqlite3* connection) const;
};
using ConnectionPtr = std::unique_ptr<sqlite3, CloseConnection>;

class RecordSet {
  public:
    RecordSet(StatementPtr statement, bool atEnd);
    ~RecordSet();
    RecordSet(const RecordSet&) = delete;
    RecordSet& operator=(const RecordSet&) = delete;

    // EOF of the platform (EOF itself is a macro of the C library): true behind the last row.
    bool Eof() const { return atEnd_; }
    // The column of the current row, found by name, case aside; Nil for no such column or
    // no current row. A field that the caller keeps keeps its text when the cursor moves on.
    Ref<DatabaseField> Field(std::string_view name) const;
    void MoveNext();
    void Close();

  private:
    Ref<DatabaseField> FieldAt(size_t column) const;

    StatementPtr statement_;
    bool atEnd_;
    std::vector<std::string> columns_;
    // The columns found by the names asked, as asked: each name looked up among the columns
    // anew made the list load of 1,000,000 results 7% longer.
    mutable std::vector<std::pair<std::string, size_t>> found_;
    mutable size_t sinceLook_ = 0;  // bytes since the last look at the process's memory
    // One field for each column, shown the next row's text while nobody else holds it: a copy
    // of each text made the list load of 1,000,000 results 1.7 times as long.
    mutable std::vector<Ref<DatabaseField>> fields_;
};

class SQLiteDatabase {
  public:
    Ref<FolderItem> DatabaseFile;

    // Opens DatabaseFile read-only if it is a regular file; true if it can now be queried. A
    // busy or locked file is waited on for at most kBusyMilliseconds.
    bool Connect();
    // Runs one statement. Nil if it fails, or if any statement follows it in the text. A
    // statement that gives no row for 30 s fails, as the step to its next row does later.
    Ref<RecordSet> SQLSelect(const std::string& statement);
    // Harmless on an object that never connected.
    void Close();

    // What a read calls while it waits for a lock or works through a query that gives no row:
    // the run-time sets its yield here, so that the windows keep painting.
    static void SetWaitHook(void (*hook)());
    static void SetQuietLimitForTesting(std::chrono::milliseconds limit);

    static constexpr int kBusyMilliseconds = 2000;

  private:
    ConnectionPtr connection_;
};
