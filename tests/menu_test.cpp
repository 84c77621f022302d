// The menu bar in its native form in the window: its shortcuts and Quit.
#include <QMenu>
#include <QStyle>

#include "platform/runtime/application_style.h"
#include "window_fixture.h"

using namespace testsupport;

using MenuTest = WindowTest;

// The native form keeps the shortcuts users reach for.
TEST_F(MenuTest, TheWindowShowsTheOneBarWithItsShortcuts) {
    auto window = StartUp();
    QMenu* edit = InMenuBar<QMenu>(window, "EditMenu");
    ASSERT_NE(edit, nullptr);
    ASSERT_EQ(edit->actions().size(), 8);
    EXPECT_TRUE(edit->actions()[1]->isSeparator());
    EXPECT_EQ(edit->actions()[3]->shortcut(), QKeySequence(QKeySequence::Copy));
    QMenu* file = InMenuBar<QMenu>(window, "FileMenu");
    ASSERT_NE(file, nullptr);
    EXPECT_EQ(file->actions().at(0)->shortcut(), QKeySequence("Ctrl+Q"));
}

TEST_F(MenuTest, QuitEndsTheEventLoopAndClosesTheWindow) {
    auto window = StartUp();
    QMenu* file = InMenuBar<QMenu>(window, "FileMenu");
    QTimer::singleShot(0, [file] { file->actions().at(0)->trigger(); });
    QTimer::singleShot(5000, [] { QCoreApplication::exit(1); });
    EXPECT_EQ(QCoreApplication::exec(), 0);
    EXPECT_FALSE(window->IsOpen());
    EXPECT_TRUE(_GetImplicitWindow("Window1.Window1").IsNil());
}

// The menu bar's overflow icon, handed over unread, draws as the desktop style's own; the
// other icons come from that style unchanged.
TEST(ApplicationStyleTest, IconsLookAsTheDesktopStylesOwn) {
    ApplicationStyle style;
    QStyle* desktop = QApplication::style();
    for (auto which : {QStyle::SP_ToolBarHorizontalExtensionButton, QStyle::SP_MessageBoxWarning}) {
        const QIcon icon = style.standardIcon(which);
        ASSERT_FALSE(icon.isNull()) << which;
        EXPECT_EQ(icon.pixmap(QSize(16, 16)).toImage(),
                  desktop->standardIcon(which).pixmap(QSize(16, 16)).toImage())
            << which;
    }
}
