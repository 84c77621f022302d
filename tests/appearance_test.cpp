// The window's background follows the appearance: at opening and at every change; a change
// with no window open makes a new one.
#include "platform/appearance.h"
#include "platform/notifications.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

class AppearanceTest : public WindowTest {
  protected:
    void TearDown() override {
        SetAppearanceForTesting(Appearance::Light);
        ProcessEvents();
        WindowTest::TearDown();
    }
};

TEST_F(AppearanceTest, OpenedInTheDarkTheWindowTakesTheDesktopColour) {
    SetAppearanceForTesting(Appearance::Dark);
    ProcessEvents();
    EXPECT_TRUE(IsDarkMode());
    auto window = StartUp();
    EXPECT_EQ(window->BackColor(), FillColor());
    EXPECT_NE(window->BackColor(), 0xFFFFFFu);
}

// Opened in the light (the fixture's default) the window is white; each change repaints it.
TEST_F(AppearanceTest, EachChangeSetsTheBackgroundAgain) {
    auto window = StartUp();
    EXPECT_EQ(window->BackColor(), 0xFFFFFFu);
    SetAppearanceForTesting(Appearance::Dark);
    ProcessEvents();
    const QImage shot = window->Client()->grab().toImage();
    const Color fill = FillColor();
    EXPECT_EQ(shot.pixel(5, 600), qRgb(Red(fill), Green(fill), Blue(fill)));

    SetAppearanceForTesting(Appearance::Light);
    ProcessEvents();
    EXPECT_EQ(window->BackColor(), 0xFFFFFFu);
    EXPECT_EQ(window->Client()->grab().toImage().pixel(5, 600), qRgb(255, 255, 255));
}

TEST_F(AppearanceTest, NotificationsAreQueuedAndDeliveredOnceEachFromTheEventLoop) {
    StartUp();
    int calls = 0;
    struct Counter : Application {
        int* calls;
        void Event_AppearanceChanged() override { ++*calls; }
    };
    Counter counter;
    counter.calls = &calls;
    _MacOSDistributedNotifications::gotCalled(_MacOSDistributedNotifications::kThemeChanged);
    _MacOSDistributedNotifications::gotCalled(
        _MacOSDistributedNotifications::kColorPreferencesChanged);
    _MacOSDistributedNotifications::gotCalled("SomeOtherNotification");
    EXPECT_EQ(calls, 0) << "nothing happens inside the callback";
    ProcessEvents();
    EXPECT_EQ(calls, 2);
    EXPECT_TRUE(_MacOSDistributedNotifications::NotificationQueue.empty());
}

TEST_F(AppearanceTest, AChangeWithoutAWindowMakesANewOneOnTheInstallationPage) {
    auto first = StartUp();
    first->Close();
    ProcessEvents();
    ASSERT_TRUE(_GetImplicitWindow("Window1.Window1").IsNil());
    SetAppearanceForTesting(Appearance::Dark);
    ProcessEvents();
    auto second = Cast<class Window1>(_GetImplicitWindow("Window1.Window1"));
    ASSERT_FALSE(second.IsNil());
    EXPECT_NE(second, first);
    EXPECT_EQ(second->MenuBar(), first->MenuBar()) << "the one menu bar serves every window";
    EXPECT_EQ(second->PagePanel1()->Value(), 0);
    EXPECT_TRUE(second->MainTabs()->Items()[0]->Selected());
    EXPECT_EQ(second->BackColor(), FillColor());
}

}  // namespace
