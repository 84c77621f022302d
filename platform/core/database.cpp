// The database classes over the SQLite C library.
#include "platform/core/database.h"

#include <sqlite3.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <string_view>
#include <system_error>

#include "platform/core/text.h"

namespace {

bool IsBlankTail(sqlite3* db, const char* tail) {
    // Only blanks and comments may follow: a second statement makes the text fail.
    while (tail && *tail) {
        sqlite3_stmt* prepared = nullptr;
        const char* rest = nullptr;
        const int result = sqlite3_prepare_v2(db, tail, -1, &prepared, &rest);
        const StatementPtr next(prepared);
        if (result != SQLITE_OK || next) {
            return false;
        }
        if (rest == tail) {
            return true;
        }
        tail = rest;
    }
    return true;
}

// A path as the path of a file: URI, with the characters that would end or escape it encoded.
std::string UriPath(const std::string& path) {
    static const char* const kHex = "0123456789ABCDEF";
    std::string out;
    for (const unsigned char c : path) {
        if (c == '%' || c == '?' || c == '#' || c < 0x21 || c >= 0x7F) {
            out += '%';
            out += kHex[c >> 4];
            out += kHex[c & 0xF];
        } else {
            out += static_cast<char>(c);
        }
    }
    return out;
}

// A database file in WAL mode (versions 2 in its header) with no -wal file beside it: the
// last writer has closed it, and everything stands in the file itself.
bool IsWalWithoutLog(const std::filesystem::path& file) {
    char header[20] = {};
    std::ifstream in(file, std::ios::binary);
    if (!in.read(header, sizeof header) ||
        std::string_view(header, 16) != std::string_view("SQLite format 3\0", 16)) {
        return false;
    }
    std::error_code error;
    return (header[18] == 2 || header[19] == 2) &&
           !std::filesystem::exists(file.string() + "-wal", error);
}

// A field that someone else still holds keeps its own copy of the text, and leaves the pool.
void LetGoIfHeld(Ref<DatabaseField>& field) {
    if (field && field.Shared().use_count() > 1) {
        field->Keep();
        field = nullptr;
    }
}

}  // namespace

void FinalizeStatement::operator()(sqlite3_stmt* statement) const {
    sqlite3_finalize(statement);
}

void CloseConnection::operator()(sqlite3* connection) const {
    sqlite3_close_v2(connection);
}

RecordSet::RecordSet(StatementPtr statement, bool atEnd)
    : statement_(std::move(statement)), atEnd_(atEnd) {
    const int count = sqlite3_column_count(statement_.get());
    for (int i = 0; i < count; ++i) {
        const char* name = sqlite3_column_name(statement_.get(), i);
        columns_.emplace_back(name ? name : "");
    }
    fields_.resize(columns_.size());
}

RecordSet::~RecordSet() {
    Close();
}

Ref<DatabaseField> RecordSet::Field(std::string_view name) const {
    if (!statement_ || atEnd_) {
        return nullptr;
    }
    for (const auto& [asked, column] : found_) {
        if (asked == name) {
            return FieldAt(column);
        }
    }
    for (size_t column = 0; column < columns_.size(); ++column) {
        if (TextEquals(columns_[column], name)) {
            found_.emplace_back(name, column);
            return FieldAt(column);
        }
    }
    return nullptr;
}

// SQLite hands out the column's value unprotected, which only matters to another thread, and
// the connection is this thread's alone.
Ref<DatabaseField> RecordSet::FieldAt(size_t column) const {
    sqlite3_value* value = sqlite3_column_value(statement_.get(), static_cast<int>(column));
    const auto* text = reinterpret_cast<const char*>(sqlite3_value_text(value));
    const auto bytes = static_cast<size_t>(sqlite3_value_bytes(value));
    Ref<DatabaseField>& field = fields_[column];
    LetGoIfHeld(field);
    if (!field) {
        field = New<DatabaseField>();
    }
    field->Show(text ? std::string_view(text, bytes) : std::string_view());
    return field;
}

// A failure while stepping ends the rows, as the end of the result would.
void RecordSet::MoveNext() {
    if (statement_ && !atEnd_) {
        std::for_each(fields_.begin(), fields_.end(), LetGoIfHeld);
        atEnd_ = sqlite3_step(statement_.get()) != SQLITE_ROW;
    }
}

void RecordSet::Close() {
    std::for_each(fields_.begin(), fields_.end(), LetGoIfHeld);
    statement_.reset();
    fields_.clear();
    atEnd_ = true;
}

bool SQLiteDatabase::Connect() {
    Close();
    if (DatabaseFile.IsNil()) {
        return false;
    }
    // Only a regular file, after links are followed, is opened: open() on a FIFO waits for a
    // writer for ever, and a folder, socket or device is no database either.
    const std::filesystem::path& file = DatabaseFile->NativePath();
    std::error_code error;
    if (!std::filesystem::is_regular_file(file, error)) {
        return false;
    }
    std::string uri = "file:" + UriPath(file.string()) + "?mode=ro";
    if (IsWalWithoutLog(file)) {
        // No writer has it open, so it is read as it stands: opened as usual, SQLite would
        // leave a -wal and a -shm file beside the store.
        uri += "&immutable=1";
    }
    sqlite3* db = nullptr;
    // A connection lives inside one handler on the one thread, so SQLite's own lock on every
    // call would be pure cost.
    const int opened = sqlite3_open_v2(
        uri.c_str(), &db, SQLITE_OPEN_READONLY | SQLITE_OPEN_URI | SQLITE_OPEN_NOMUTEX, nullptr);
    ConnectionPtr connection(db);
    if (opened != SQLITE_OK) {
        return false;
    }
    sqlite3_busy_timeout(db, kBusyMilliseconds);
    // Opening is lazy: reading the schema tells whether this is a database that can be read.
    if (sqlite3_exec(db, "select count(*) from sqlite_master", nullptr, nullptr, nullptr) !=
        SQLITE_OK) {
        return false;
    }
    connection_ = std::move(connection);
    return true;
}

Ref<RecordSet> SQLiteDatabase::SQLSelect(const std::string& statement) {
    if (!connection_) {
        return nullptr;
    }
    sqlite3_stmt* prepared = nullptr;
    const char* tail = nullptr;
    const int result = sqlite3_prepare_v2(connection_.get(), statement.c_str(),
                                          static_cast<int>(statement.size()), &prepared, &tail);
    StatementPtr owned(prepared);
    if (result != SQLITE_OK || !owned) {
        return nullptr;
    }
    const std::string rest(tail, statement.c_str() + statement.size() - tail);
    if (!IsBlankTail(connection_.get(), rest.c_str())) {
        return nullptr;
    }
    const int first = sqlite3_step(owned.get());
    if (first != SQLITE_ROW && first != SQLITE_DONE) {
        return nullptr;
    }
    return New<RecordSet>(std::move(owned), first == SQLITE_DONE);
}

void SQLiteDatabase::Close() {
    connection_.reset();
}
