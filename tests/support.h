// Test support: temporary trees, the file-system root, message capture, SQL on a store, and a
// clean slate of windows and application object for each test.
#pragma once

#include <QApplication>
#include <QCoreApplication>
#include <QEvent>
#include <QTimer>

#include <gtest/gtest.h>
#include <sqlite3.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "platform/runtime/application.h"
#include "platform/runtime/message_box.h"
#include "platform/widgets/window.h"

namespace testsupport {

// A fresh folder under the system's temporary folder, removed with everything in it.
class TempDir {
  public:
    TempDir() {
        std::string pattern =
            (std::filesystem::temp_directory_path() / "orbelane-test-XXXXXX").string();
        path_ = mkdtemp(pattern.data());
    }
    ~TempDir() {
        std::error_code error;
        std::filesystem::remove_all(path_, error);
    }
    TempDir(const TempDir&) = delete;
    TempDir& operator=(const TempDir&) = delete;
    const std::filesystem::path& Path() const { return path_; }

  private:
    std::filesystem::path path_;
};

// Puts the system's absolute paths under a temporary root for the life of the object.
class ScopedRoot {
  public:
    explicit ScopedRoot(const std::filesystem::path& root) {
        setenv("ORBELANE_ROOT", root.c_str(), 1);
    }
    ~ScopedRoot() { unsetenv("ORBELANE_ROOT"); }
};

// Reads every message that MsgBox would show.
class MessageLog {
  public:
    MessageLog() {
        SetMsgBoxHandlerForTesting([this](const std::string& text) { messages.push_back(text); });
    }
    ~MessageLog() { SetMsgBoxHandlerForTesting(nullptr); }
    std::vector<std::string> messages;
};

inline void WriteFile(const std::filesystem::path& path, const std::string& bytes) {
    std::filesystem::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary) << bytes;
}

inline std::string ReadFile(const std::filesystem::path& path) {
    std::ifstream in(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

// Runs SQL on a store as the plug-in would, with its own connection.
inline void ExecSql(const std::filesystem::path& store, const std::string& sql) {
    sqlite3* db = nullptr;
    sqlite3_open(store.c_str(), &db);
    EXPECT_EQ(sqlite3_exec(db, sql.c_str(), nullptr, nullptr, nullptr), SQLITE_OK) << sql;
    sqlite3_close(db);
}

// Lets queued timers and posted events run.
inline void ProcessEvents() {
    for (int i = 0; i < 3; ++i) {
        QCoreApplication::processEvents();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
}

// Every test starts and ends without windows and without an application object.
class SlateTest : public ::testing::Test {
  protected:
    void TearDown() override {
        QApplication::closeAllWindows();
        ProcessEvents();
        _RuntimeRegisterAppObject(nullptr);
    }
};

// A slate whose file-system root is a temporary tree of its own.
class RootedTest : public SlateTest {
  protected:
    TempDir tree;
    ScopedRoot root{tree.Path()};
};

}  // namespace testsupport
