// The desktop's dark mode from the settings portal, on a private session bus that this test
// starts and stops, with a stand-in portal in a thread of its own: followed on each change
// through the window's colour and the list's stripes.
#include <QDBusAbstractAdaptor>
#include <QDBusConnection>
#include <QDBusVariant>
#include <QProcess>
#include <QThread>

#include <sys/prctl.h>

#include <atomic>
#include <csignal>

#include "platform/runtime/appearance.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

constexpr const char* kGroup = "org.freedesktop.appearance";
constexpr const char* kKey = "color-scheme";
constexpr uint kNoPreference = 0, kDark = 1, kLight = 2;

// What the desktop's portal answers about its settings; it keeps only the colour scheme.
class StandInSettings : public QDBusAbstractAdaptor {
    Q_OBJECT
    Q_CLASSINFO("D-Bus Interface", "org.freedesktop.portal.Settings")

  public:
    explicit StandInSettings(QObject* portal) : QDBusAbstractAdaptor(portal) {}
    std::atomic<uint> scheme{kNoPreference};

  public slots:
    // As the portal's own Read, the value comes wrapped twice.
    QDBusVariant Read(const QString& group, const QString& key) {
        const QVariant value =
            group == kGroup && key == kKey ? QVariant(scheme.load()) : QVariant();
        return QDBusVariant(QVariant::fromValue(QDBusVariant(value)));
    }

  signals:
    void SettingChanged(const QString& group, const QString& key, const QDBusVariant& value);
};

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
        ASSERT_TRUE(bus.registerObject("/org/freedesktop/portal/desktop", portal_));
        bus.registerService("org.freedesktop.portal.Desktop");
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
        settings->scheme = scheme;
        QMetaObject::invokeMethod(
            settings,
            [scheme] {
                emit settings->SettingChanged(kGroup, kKey, QDBusVariant(QVariant(scheme)));
            },
            Qt::BlockingQueuedConnection);
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
        SetAppearanceForTesting(Appearance::Light);
        ProcessEvents();
        WindowTest::TearDown();
    }
    bool WaitForBackColor(const Ref<class Window1>& window, bool dark) {
        return QTest::qWaitFor([&] { return (window->BackColor() != 0xFFFFFF) == dark; }, 5000);
    }
};

TEST_F(PortalTest, SwitchingRecoloursTheWindowAndTheStripes) {
    PrivateSessionBus::settings->scheme = kLight;
    Store({{"1", "2018", "Box.ai", "A", "Code reads 42"},
           {"2", "2019", "Jar.ai", "B", "Code reads 7"}});
    auto window = StartUp();
    ASSERT_FALSE(IsDarkMode());

    PrivateSessionBus::Switch(kDark);
    ASSERT_TRUE(WaitForBackColor(window, true));
    EXPECT_EQ(window->BackColor(), FillColor());
    EXPECT_EQ(Pixel(window->Client(), 5, 600), Rgb(FillColor()));
    EXPECT_EQ(Stripe(window, 0), qRgb(22, 22, 22));
    EXPECT_EQ(Stripe(window, 1), Rgb(FillColor()));

    PrivateSessionBus::Switch(kLight);
    ASSERT_TRUE(WaitForBackColor(window, false));
    EXPECT_EQ(Pixel(window->Client(), 5, 600), qRgb(255, 255, 255));
    EXPECT_EQ(Stripe(window, 0), qRgb(237, 243, 254));
    EXPECT_EQ(Stripe(window, 1), qRgb(255, 255, 255));
}

}  // namespace

#include "portal_test.moc"
