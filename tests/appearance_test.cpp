// The window's background and the list's stripes follow the appearance: at opening and at every
// change; a change with no window open makes a new one.
#include "platform/runtime/appearance.h"
#include "platform/runtime/notifications.h"
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

// Opened in the light (the fixture's default) the window is white; each change recolours it
// and the list's stripes, and the selected row still shows.
TEST_F(AppearanceTest, EachChangeRecoloursTheWindowAndTheStripes) {
    Store({{"1", "", "", "A", ""}, {"2", "", "", "A", ""}, {"3", "", "", "A", ""}});
    auto window = StartUp();
    EXPECT_EQ(window->BackColor(), 0xFFFFFFu);
    EXPECT_EQ(Stripe(window, 0), qRgb(237, 243, 254));
    EXPECT_EQ(Stripe(window, 1), qRgb(255, 255, 255));

    SetAppearanceForTesting(Appearance::Dark);
    EXPECT_EQ(Stripe(window, 2), qRgb(22, 22, 22));
    window->Listbox1()->SetListIndex(2);
    EXPECT_NE(Stripe(window, 2), qRgb(22, 22, 22)) << "the selected row is marked";

    SetAppearanceForTesting(Appearance::Light);
    ProcessEvents();
    EXPECT_EQ(window->BackColor(), 0xFFFFFFu);
    EXPECT_EQ(Pixel(window->Client(), 5, 600), qRgb(255, 255, 255));
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
