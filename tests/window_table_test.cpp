// The window as built from its property blocks and control table: its frame, the controls'
// starting states and a text pane's font; the menu bar in its native form: Quit, and the icons
// of its style.
#include <QFontInfo>
#include <QMenu>
#include <QStyle>

#include "platform/runtime/application_style.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

using WindowTableTest = WindowTest;

// Only what the window and the controls do; their texts and rows are checked where they are met.
TEST_F(WindowTableTest, TheWindowAndItsControlsStartAsAUserFindsThem) {
    auto window = StartUp();
    QWidget* native = window->Native();
    EXPECT_EQ(native->minimumSize(), native->maximumSize()) << "a fixed size";
    const Qt::WindowFlags flags = native->windowFlags();
    EXPECT_TRUE(flags & Qt::WindowCloseButtonHint);
    EXPECT_FALSE(flags & (Qt::WindowMinimizeButtonHint | Qt::WindowMaximizeButtonHint |
                          Qt::WindowFullscreenButtonHint));

    EXPECT_THROW(window->Label5(8)->Text(), NilObjectException) << "a set has its own indexes";
    window->TextArea1()->SetText("Bar 1 330");
    QTest::keyClicks(window->TextArea1()->Widget(), "x\b");
    EXPECT_EQ(window->TextArea1()->Text(), "Bar 1 330") << "read-only";
    EXPECT_EQ(window->MainTabs()->Widget()->width(), 920) << "sized to fit its two segments";
    // The text areas lie above the tab panel that holds them, or they would never show.
    const QObjectList order = window->Client()->children();
    const qsizetype panel = order.indexOf(window->TabPanel1()->Widget());
    EXPECT_GT(order.indexOf(window->TextArea1()->Widget()), panel);
    EXPECT_GT(order.indexOf(window->TextArea2()->Widget()), panel);

    // A text pane given a text while hidden lays it out in its own font once shown; a family
    // missing here shows in the face that the desktop gives in its place.
    window->TextArea2()->SetText("Bar 1 660");
    for (long long page : {0, 2, 1}) {
        window->PagePanel1()->SetValue(page);
    }
    window->TabPanel1()->SetValue(0);
    const QFont font = window->TextArea2()->Widget()->font();
    EXPECT_EQ(QFontInfo(font).family(), QFontInfo(QFont("Courier")).family());
    EXPECT_EQ(font.pixelSize(), -1);
}

// Quit, with the shortcut users reach for; Copy's is met in keyboard_test.
TEST_F(WindowTableTest, QuitEndsTheEventLoopAndClosesTheWindow) {
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

}  // namespace
