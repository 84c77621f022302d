// The database classes over the SQLite C library.
#include "platform/core/database.h"

#include <sqlite3.h>

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <string_view>
#include <system_error>
#include <thread>

#include "platform/core/memory_bound.h"
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

using Clock = std::chrono::steady_clock;

constexpr auto kLockWait = std::chrono::milliseconds(SQLiteDatabase::kBusyMilliseconds);
constexpr auto kLockPause = std::chrono::milliseconds(10);
constexpr int kProgressInstructions = 1000;
// Texts handed out, a row counting as this much at least, between two looks at the memory.
constexpr size_t kRowWeight = 1024;
constexpr size_t kLookEvery = size_t{4} << 20;

void (*waitHook)() = nullptr;
std::chrono::milliseconds quietLimit = std::chrono::seconds(30);
// When the current call into SQLite began. Reads run on one thread, one call at a time.
Clock::time_point workBegan;

// A lock that another connection holds is waited for, kLockWait at most, with the hook called
// between two tries.
int OnBusy(void*, int tries) {
    static Clock::time_point waitBegan;
    const auto now = Clock::now();
    if (tries == 0) {
        waitBegan = now;
    }
    if (now - waitBegan >= kLockWait) {
        return 0;
    }
    if (waitHook) {
        waitHook();
    }
    std::this_thread::sleep_for(kLockPause);
    return 1;
}

// Called every kProgressInstructions steps of SQLite's machine: a call that has given no row for
// the quiet limit is interrupted, and fails as any other failed call does.
int OnProgress(void*) {
    if (Clock::now() - workBegan > quietLimit) {
        return 1;
    }
    if (waitHook) {
        waitHook();
    }
    return 0;
}

int Step(sqlite3_stmt* statement) {
    workBegan = Clock::now();
    return sqlite3_step(statement);
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
    sinceLook_ += bytes;
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
        // Rows that would take the process past its memory bound end here, as a failed step
        // ends them: the caller keeps what it has.
        sinceLook_ += kRowWeight;
        if (sinceLook_ >= kLookEvery) {
            sinceLook_ = 0;
            if (PastMemoryBound()) {
                atEnd_ = true;
                return;
            }
        }
        atEnd_ = Step(statement_.get()) != SQLITE_ROW;
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
    // Read under SQLite's own locks, so that a read sees one committed state of a file that a
    // writer changes meanwhile. In WAL mode they live in a -shm file beside the store, which
    // SQLite makes, with an empty -wal, if no writer has.
    const std::string uri = "file:" + UriPath(file.string()) + "?mode=ro";
    sqlite3* db = nullptr;
    // A connection lives inside one handler on the one thread, so SQLite's own lock on every
    // call would be pure cost.
    const int opened = sqlite3_open_v2(
        uri.c_str(), &db, SQLITE_OPEN_READONLY | SQLITE_OPEN_URI | SQLITE_OPEN_NOMUTEX, nullptr);
    ConnectionPtr connection(db);
    if (opened != SQLITE_OK) {
        return false;
    }
    sqlite3_busy_handler(db, OnBusy, nullptr);
    sqlite3_progress_handler(db, kProgressInstructions, OnProgress, nullptr);
    // Opening is lazy: reading the schema tells whether this is a database that can be read.
    workBegan = Clock::now();
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
    workBegan = Clock::now();  // a changed schema is read again here
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
    const int first = Step(owned.get());
    if (first != SQLITE_ROW && first != SQLITE_DONE) {
        return nullptr;
    }
    return New<RecordSet>(std::move(owned), first == SQLITE_DONE);
}

void SQLiteDatabase::Close() {
    connection_.reset();
}

void SQLiteDatabase::SetWaitHook(void (*hook)()) {
    waitHook = hook;
}

void SQLiteDatabase::SetQuietLimitForTesting(std::chrono::milliseconds limit) {
    quietLimit = limit;
}
