// The run-time's edges: the exception helper keeps the class of what it catches, start-up takes
// nothing from the command line and makes a relative root absolute, and window, control and
// message operations refuse any thread but the main one.
#include <unistd.h>

#include <QProcess>

#include <thread>

#include "platform/runtime/runtime.h"
#include "window_fixture.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

TEST(ExceptionHelper, HandsBackTheExceptionItselfWithItsClass) {
    auto caught =
        _CallFunctionWithExceptionHandling([](void*) { throw EndException("bye"); }, nullptr);
    ASSERT_TRUE(caught);
    EXPECT_EQ(caught->ClassName(), "EndException");
    EXPECT_EQ(caught->Message, "bye");

    caught = _CallFunctionWithExceptionHandling([](void*) { throw NilObjectException(); }, nullptr);
    ::testing::internal::CaptureStderr();
    _UnhandledException(*caught);
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "Unhandled NilObjectException\n");

    EXPECT_FALSE(_CallFunctionWithExceptionHandling([](void*) {}, nullptr));
    EXPECT_THROW(_CallFunctionWithExceptionHandling([](void*) { throw std::bad_alloc(); }, nullptr),
                 std::bad_alloc);
}

using RootTest = SlateTest;

TEST_F(RootTest, ARelativeRootIsMadeAbsoluteAtStart) {
    TempDir tree;
    fs::create_directories(tree.Path() / "root/Library/Application Support/Tamsorel");
    const fs::path startedIn = fs::current_path();
    fs::current_path(tree.Path());
    ScopedRoot root{"root/"};
    char name[] = "orbelane";
    char* argv[] = {name, nullptr};
    RuntimeInit(1, argv);
    fs::current_path(startedIn);  // a later change of folder no longer matters

    Ref<FolderItem> store = GetFolderItem("/Library/Application\\ Support/Tamsorel/results.db", 1);
    ASSERT_FALSE(store.IsNil());
    EXPECT_EQ(store->NativePath(),
              tree.Path() / "root/Library/Application Support/Tamsorel/results.db");
    EXPECT_EQ(store->ShellPath(), "/Library/Application\\ Support/Tamsorel/results.db");
}

// The real program, given options that Qt would obey: -platform with a plug-in that does not
// exist makes Qt end the process at once, so a program still running after the wait has
// ignored it.
TEST(CommandLine, NothingOnTheCommandLineReachesQt) {
    TempDir tree;
    QProcess program;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert("QT_QPA_PLATFORM", "offscreen");
    environment.insert("ORBELANE_ROOT", QString::fromStdString(tree.Path().string()));
    program.setProcessEnvironment(environment);
    program.start(ORBELANE_PROGRAM, {"-platform", "no-such-platform", "-reverse"});
    ASSERT_TRUE(program.waitForStarted(10000));
    EXPECT_FALSE(program.waitForFinished(3000))
        << "the program ended: " << program.readAllStandardError().toStdString();
    program.kill();
    program.waitForFinished(10000);
}

using ThreadGuardTest = WindowTest;

TEST_F(ThreadGuardTest, WindowControlAndMessageOperationsRefuseOtherThreads) {
    auto window = StartUp();
    auto panel = window->PagePanel1();
    MessageLog log;
    std::vector<std::string> refused;
    std::thread([&] {
        auto attempt = [&](const char* name, const std::function<void()>& operation) {
            try {
                operation();
            } catch (const ThreadAccessingUIException& e) {
                EXPECT_EQ(e.Message,
                          "A thread has attempted to manipulate a user interface element. This "
                          "can only be done from the application's main thread.");
                refused.push_back(name);
            }
        };
        attempt("MsgBox", [] { MsgBox("from a thread"); });
        attempt("BackColor", [&] { window->SetBackColor(0); });
        attempt("ControlByName", [&] { window->_ControlByName("Listbox1"); });
        attempt("Close", [&] { window->Close(); });
        attempt("ImplicitWindow", [] { _GetImplicitWindow("Window1.Window1"); });
        attempt("Control", [&] { panel->SetValue(0); });
    }).join();
    EXPECT_EQ(refused, (std::vector<std::string>{"MsgBox", "BackColor", "ControlByName", "Close",
                                                 "ImplicitWindow", "Control"}));
    EXPECT_TRUE(log.messages.empty());
    EXPECT_TRUE(window->IsOpen());
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
}

}  // namespace
