// The menu bar: its structure, its native form in the window, its style's icon, and quitting.
#include <QAction>
#include <QApplication>
#include <QClipboard>
#include <QGuiApplication>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPlainTextEdit>

#include "platform/runtime/runtime.h"
#include "shell/main_menu_bar.h"
#include "shell/startup.h"
#include "shell/window1.h"
#include "support.h"

using namespace testsupport;

namespace {
class MenuTest : public RootedTest {};

QMenu* NativeMenu(const Ref<class Window1>& window, const char* name) {
    auto* bar = static_cast<QMainWindow*>(window->Native())->menuBar();
    return bar->findChild<QMenu*>(name);
}
}  // namespace

// One bar for every window; its native form keeps the shortcuts users reach for.
TEST_F(MenuTest, TheWindowShowsTheOneBarWithItsShortcuts) {
    _EarlyStartup();
    auto window = Window1();
    EXPECT_EQ(MainMenuBar(), MainMenuBar()) << "built once";
    EXPECT_TRUE(MainMenuBar()->Child("EditSelectAll").IsNil()) << "Child looks one level down";
    QMenu* edit = NativeMenu(window, "EditMenu");
    ASSERT_NE(edit, nullptr);
    ASSERT_EQ(edit->actions().size(), 8);
    EXPECT_TRUE(edit->actions()[1]->isSeparator());
    EXPECT_EQ(edit->actions()[3]->shortcut(), QKeySequence(QKeySequence::Copy));
    QMenu* file = NativeMenu(window, "FileMenu");
    ASSERT_NE(file, nullptr);
    EXPECT_EQ(file->actions().at(0)->shortcut(), QKeySequence("Ctrl+Q"));
}

TEST_F(MenuTest, CopyAndSelectAllWorkOnTheFocusedReportText) {
    _EarlyStartup();
    auto window = Window1();
    window->PagePanel1()->SetValue(2);
    window->TextArea1()->SetText("    Bar 1 330\rBar 2 660");
    window->Native()->activateWindow();
    window->TextArea1()->Widget()->setFocus();
    ProcessEvents();
    window->EditSelectAll()->Action();
    auto* editor = static_cast<QPlainTextEdit*>(window->TextArea1()->Widget());
    EXPECT_EQ(editor->textCursor().selectedText().size(), editor->toPlainText().size());
    QGuiApplication::clipboard()->clear();
    window->EditCopy()->Action();
    EXPECT_EQ(QGuiApplication::clipboard()->text().toStdString(), "    Bar 1 330\nBar 2 660");
}

TEST_F(MenuTest, QuitEndsTheEventLoopAndClosesTheWindow) {
    _EarlyStartup();
    auto window = Window1();
    QMenu* file = NativeMenu(window, "FileMenu");
    QTimer::singleShot(0, [file] { file->actions().at(0)->trigger(); });
    QTimer::singleShot(5000, [] { QCoreApplication::exit(1); });
    EXPECT_EQ(QCoreApplication::exec(), 0);
    EXPECT_FALSE(window->IsOpen());
    EXPECT_TRUE(_GetImplicitWindow("Window1.Window1").IsNil());
}
