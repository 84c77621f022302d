// Start-up, the state machine of pages and segments, and the lifecycle of the window; and the
// run-time's edges: the exception helper keeps the class of what it catches, start-up takes
// nothing from the command line and makes a relative root absolute, and window, control and
// message operations refuse any thread but the main one.
#include <QProcess>

#include <algorithm>
#include <thread>

#include "platform/runtime/runtime.h"
#include "window_fixture.h"

using namespace testsupport;
namespace fs = std::filesystem;

namespace {

enum class State { Installing, Listing, Reporting };

State StateOf(const Ref<class Window1>& window) {
    const long long page = window->PagePanel1()->Value();
    const bool first = window->MainTabs()->Items()[0]->Selected();
    const bool second = window->MainTabs()->Items()[1]->Selected();
    EXPECT_NE(first, second) << "exactly one segment is selected";
    if (page == 0) {
        EXPECT_TRUE(first) << "page 0 goes with the first segment";
        return State::Installing;
    }
    EXPECT_TRUE(second) << "pages 1 and 2 go with the second segment";
    return page == 1 ? State::Listing : State::Reporting;
}

using ShellTest = WindowTest;

// The real _Main, ended as soon as the list is painted. The window is built on the installation
// page, but the user's first sight is the list.
TEST_F(ShellTest, MainPaintsTheEmptyListFirstAndNeverTheInstallationPage) {
    struct PaintCount : QObject {
        int installPage = 0;
        int listPage = 0;
        bool eventFilter(QObject* watched, QEvent* event) override {
            if (event->type() != QEvent::Paint) {
                return false;
            }
            if (auto window = Cast<class Window1>(_GetImplicitWindow("Window1.Window1"))) {
                auto* list = static_cast<QTableView*>(window->Listbox1()->Widget());
                installPage += watched == window->PushButton1()->Widget() ? 1 : 0;
                listPage += watched == list->viewport() ? 1 : 0;
            }
            return false;
        }
    } count;
    QApplication::instance()->installEventFilter(&count);
    QTimer poll;
    QObject::connect(&poll, &QTimer::timeout, [&count] {
        if (count.listPage > 0) {
            QCoreApplication::exit(0);  // quit() would close the window too
        }
    });
    poll.start(10);
    QTimer::singleShot(5000, [] { QCoreApplication::exit(1); });
    _Main();
    QApplication::instance()->removeEventFilter(&count);

    auto window = Window1();
    EXPECT_GT(count.listPage, 0);
    EXPECT_EQ(count.installPage, 0);
    EXPECT_EQ(StateOf(window), State::Listing);
    EXPECT_EQ(window->Listbox1()->ListCount(), 0);
    EXPECT_EQ(window->Title(), "Orbelane Verification Storage");
    EXPECT_TRUE(window->Native()->isVisible());
    EXPECT_EQ(std::ranges::count_if(QApplication::topLevelWidgets(), &QWidget::isVisible), 1);
}

// The platform may raise Open before late start-up: the window is then built in Open, and late
// start-up makes no other.
TEST_F(ShellTest, OpenBeforeLateStartupLeavesOneWindowOnTheList) {
    _EarlyStartup();
    CurrentApplication()->Event_Open();
    _LateStartup();
    EXPECT_EQ(std::ranges::count_if(QApplication::topLevelWidgets(), &QWidget::isVisible), 1);
    EXPECT_EQ(StateOf(Window1()), State::Listing);
}

// Every way between the pages: from each state, each segment and the report's Close.
TEST_F(ShellTest, PagesAndSegmentsFollowTheStateTable) {
    using enum State;
    enum Action { Segment0, Segment1, Close };
    const struct {
        State from;
        Action action;
        State to;
    } table[] = {{Installing, Segment1, Listing},  {Installing, Segment0, Installing},
                 {Listing, Segment0, Installing},  {Listing, Segment1, Listing},
                 {Reporting, Close, Listing},      {Reporting, Segment1, Listing},
                 {Reporting, Segment0, Installing}};
    auto window = StartUp();
    // Each page shows only its own controls; a tab chosen while its page is hidden shows.
    const auto shown = [&](const Ref<Control>& c) { return c->Widget()->isVisible(); };
    window->TabPanel1()->SetValue(1);
    for (const auto& t : table) {
        SCOPED_TRACE(::testing::Message() << "row " << &t - table);
        window->MainTabs()->Press(1);  // back on the list
        if (t.from == Installing) {
            window->MainTabs()->Press(0);
        } else if (t.from == Reporting) {
            window->PagePanel1()->SetValue(2);  // where a double click that loads leads
        }
        EXPECT_EQ(StateOf(window), t.from);
        if (t.action == Close) {
            window->PushButton2()->Push();
        } else {
            window->MainTabs()->Press(t.action);  // the segment's index
        }
        EXPECT_EQ(StateOf(window), t.to);
        EXPECT_EQ(shown(window->PushButton1()), t.to == Installing);
        EXPECT_EQ(shown(window->Listbox1()), t.to == Listing);
        EXPECT_EQ(shown(window->TextArea2()), t.to == Reporting);
        EXPECT_FALSE(shown(window->TextArea1()));
    }
}

TEST_F(ShellTest, EndExceptionLeavesAHandlerWithoutAReport) {
    _EarlyStartup();
    ::testing::internal::CaptureStderr();
    RaiseEvent([] { throw EndException(); });
    RaiseEvent([] { throw ThreadEndException(); });
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "");
}

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
    std::thread([&] {
        try {
            MsgBox("from a thread");
            ADD_FAILURE() << "MsgBox";
        } catch (const ThreadAccessingUIException& e) {
            EXPECT_EQ(e.Message,
                      "A thread has attempted to manipulate a user interface element. This can "
                      "only be done from the application's main thread.");
        }
        EXPECT_THROW(window->SetBackColor(0), ThreadAccessingUIException);
        EXPECT_THROW(window->_ControlByName("Listbox1"), ThreadAccessingUIException);
        EXPECT_THROW(window->Close(), ThreadAccessingUIException);
        EXPECT_THROW(_GetImplicitWindow("Window1.Window1"), ThreadAccessingUIException);
        EXPECT_THROW(panel->SetValue(0), ThreadAccessingUIException);
    }).join();
    EXPECT_TRUE(log.messages.empty());
    EXPECT_TRUE(window->IsOpen());
    EXPECT_EQ(window->PagePanel1()->Value(), 1);
}

}  // namespace
