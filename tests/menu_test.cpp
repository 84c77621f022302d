// The menu bar in its native form in the window: Quit, and the icons of its style.
#include <QMenu>
#include <QStyle>

#include "platform/runtime/application_style.h"
#include "window_fixture.h"

using namespace testsupport;

using MenuTest = WindowTest;

// Quit, with the shortcut users reach for; Copy's is met in keyboard_test.
TEST_F(MenuTest, QuitEndsTheEventLoopAndClosesTheWindow) {
    auto window = StartUp();
    QMenu* file = InMenuBar<QMenu>(window, "FileMenu");
    ASSERT_NE(file, nullptr);
    EXPECT_EQ(file->actions().at(0)->shortcut(), QKeySequence("Ctrl+Q"));
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
