// The desktop's dark mode from the settings portal, on a private session bus that this test
// starts and stops, with a stand-in portal in a thread of its own: the window starts in the
// desktop's scheme and ends in the one that the desktop has last, however fast it switches. What
// each appearance looks like is read off the pixels in appearance_test.
#include <QDBusConnection>
#include <QProcess>
#include <QThread>

#include <sys/prctl.h>

#include <csignal>

#include "contrast.h"
#include "scripts/stand_in_portal.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

constexpr uint kNoPreference = StandInSettings::kNoPreference;
constexpr uint kDark = StandInSettings::kDark, kLight = StandInSettings::kLight;

// A session bus of our own, with nothing to activate, and the stand-in portal on it.
class PrivateSessionBus : public ::testing::Environment {
  public:
    void SetUp() override {
        WriteFile(folder_.Path() / "bus.conf",
                  "<busconfig><type>session</type><listen>unix:dir=" + folder_.Path().string() +
                      "</listen><policy context=\"default\"><allow send_destination=\"*\"/>"
                      "<allow eavesdrop=\"true\"/><allow own=\"*\"/></policy></busconfig>");
        // The bus ends with this process, even when a test aborts it.
        daemon_.setChildProcessModifier([] { prctl(PR_SET_PDEATHSIG, SIGTERM); });
        daemon_.start("dbus-daemon",
                      {"--config-file=" + QString::fromStdString((folder_.Path() / "bus.conf")),
                       "--nofork", "--print-address"});
        ASSERT_TRUE(daemon_.waitForStarted(5000)) << "dbus-daemon (Debian package dbus) runs";
        ASSERT_TRUE(daemon_.waitForReadyRead(5000));
        const QByteArray address = daemon_.readLine().trimmed();
        qputenv("DBUS_SESSION_BUS_ADDRESS", address);

        qRegisterMetaType<QDBusVariant>();
        thread_.start();
        portal_ = new QObject;
        settings = new StandInSettings(portal_);
        portal_->moveToThread(&thread_);
        QDBusConnection bus = QDBusConnection::connectToBus(QString(address), "stand-in");
        ASSERT_TRUE(bus.registerObject(StandInSettings::kPath, portal_));
        bus.registerService(StandInSettings::kService);
    }
    void TearDown() override {
        QDBusConnection::disconnectFromBus("stand-in");
        portal_->deleteLater();
        thread_.quit();
        thread_.wait();
        daemon_.terminate();
        daemon_.waitForFinished(5000);
    }

    // The desktop switches: the portal tells everyone who listens.
    static void Switch(uint scheme) {
        QMetaObject::invokeMethod(
            settings, [scheme] { settings->Switch(scheme); }, Qt::BlockingQueuedConnection);
    }

    static inline StandInSettings* settings = nullptr;

  private:
    TempDir folder_;
    QProcess daemon_;
    QThread thread_;
    QObject* portal_ = nullptr;
};

[[maybe_unused]] const auto* const bus = ::testing::AddGlobalTestEnvironment(new PrivateSessionBus);

class PortalTest : public WindowTest {
  protected:
    void TearDown() override {
        PrivateSessionBus::settings->scheme = kNoPreference;
        WindowTest::TearDown();
    }
    bool WaitForBackColor(const Ref<class Window1>& window, bool dark) {
        return QTest::qWaitFor([&] { return (window->BackColor() != 0xFFFFFF) == dark; }, 5000);
    }
};

// The window opens in the scheme that the desktop has at start. A desktop that then switches
// many times a second, during a list load or under an open message box: the window ends in the
// appearance that the desktop has last, where no preference counts as light.
TEST_F(PortalTest, TheWindowEndsInTheAppearanceThatTheDesktopHasLast) {
    PrivateSessionBus::settings->scheme = kDark;
    Store(demo::InventedResults(500));
    auto window = StartUp();
    const auto endsIn = [&](bool dark) {
        EXPECT_TRUE(WaitForBackColor(window, dark));
        QTest::qWait(100);  // every notification delivered
        EXPECT_EQ(IsDarkMode(), dark);
        EXPECT_EQ(window->BackColor(), dark ? FillColor() : 0xFFFFFFu);
        const QImage hint = Shown(window, *window->Label3());
        EXPECT_EQ(Ink(hint, Ground(hint)),
                  QApplication::palette().color(QPalette::WindowText).rgb());
    };
    endsIn(true);
    for (int i = 0; i < 21; ++i) {
        PrivateSessionBus::Switch(i % 2 ? kDark : kLight);
    }
    endsIn(false);

    // The load holds every event back, the desktop's word too, until it has ended.
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    int paints = 0;
    SetYieldPaintObserverForTesting([&](auto) {
        if (++paints <= 3) {
            PrivateSessionBus::Switch(paints % 2 ? kDark : kLight);
        }
    });
    window->PagePanel1()->SetValue(1);
    SetYieldPaintObserverForTesting(nullptr);
    SetYieldIntervalForTesting(std::chrono::milliseconds(50));
    ASSERT_GT(paints, 3);
    endsIn(true);

    // A message box runs the event loop: the window follows while the box is open.
    QTimer::singleShot(0, [&] {
        for (uint scheme : {kLight, kDark, kNoPreference}) {
            PrivateSessionBus::Switch(scheme);
        }
        EXPECT_TRUE(WaitForBackColor(window, false));
        QWidget* box = QApplication::activeModalWidget();
        ASSERT_NE(box, nullptr);
        box->close();
    });
    MsgBox("Unable to install at this time 1");
    endsIn(false);
}

}  // namespace
