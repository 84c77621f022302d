// The desktop's dark mode from the settings portal, on a private session bus that this test
// starts and stops, with a stand-in portal in a thread of its own: followed on each change
// through the window's colour, the list's stripes and every text, read off the pixels.
#include <QAbstractScrollArea>
#include <QDBusConnection>
#include <QProcess>
#include <QPushButton>
#include <QThread>

#include <sys/prctl.h>

#include <csignal>

#include "contrast.h"
#include "platform/runtime/appearance.h"
#include "platform/runtime/yield.h"
#include "scripts/stand_in_portal.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

constexpr uint kNoPreference = StandInSettings::kNoPreference;
constexpr uint kDark = StandInSettings::kDark, kLight = StandInSettings::kLight;
// The least contrast of text on its ground that reads for a person with weaker sight.
constexpr double kReadable = 4.5;

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
        SetAppearanceForTesting(Appearance::Light);
        ProcessEvents();
        WindowTest::TearDown();
    }
    bool WaitForBackColor(const Ref<class Window1>& window, bool dark) {
        return QTest::qWaitFor([&] { return (window->BackColor() != 0xFFFFFF) == dark; }, 5000);
    }
    // The desktop switches, and the window has followed.
    void SwitchTo(const Ref<class Window1>& window, uint scheme) {
        PrivateSessionBus::Switch(scheme);
        ASSERT_TRUE(WaitForBackColor(window, scheme == kDark));
        ProcessEvents();
    }
    // A control as the window shows it, with what lies beneath it.
    static QImage Shown(const Ref<class Window1>& window, const Control& control) {
        ProcessEvents();
        return window->Client()
            ->grab(QRect(control.Left(), control.Top(), control.Width(), control.Height()))
            .toImage();
    }
    // The inside of a text pane, without its frame and scrollbar.
    static QImage Inside(const TextArea& pane) {
        ProcessEvents();
        return static_cast<QAbstractScrollArea*>(pane.Widget())->viewport()->grab().toImage();
    }
    static void ExpectReadable(const QImage& image, const std::string& what) {
        const QRgb ground = Ground(image);
        const double contrast = Contrast(Ink(image, ground), ground);
        EXPECT_GE(contrast, kReadable) << what << (IsDarkMode() ? " in the dark" : " in the light");
    }
};

// Each switch recolours the window and the stripes, and every text takes the desktop's colours
// as the framework paints stored solid black text and a white ground: on the report page, the
// list page and the installation page.
TEST_F(PortalTest, EachSwitchRecoloursTheWindowAndEveryTextReadsOnItsGround) {
    PrivateSessionBus::settings->scheme = kLight;
    Store({{"1", "2018", "Box.ai", "A", demo::ReportText(demo::Layout::A, "42", "EAN 8", 3)},
           {"2", "2019", "Jar.ai", "B", "Code reads 7"}});
    auto window = StartUp();
    DoubleClickRow(window, 0);
    ASSERT_EQ(window->PagePanel1()->Value(), 2);
    for (uint scheme : {kDark, kLight, kDark}) {
        SwitchTo(window, scheme);
        const QPalette desktop = QApplication::palette();
        const bool dark = scheme == kDark;
        EXPECT_EQ(window->BackColor(), dark ? FillColor() : 0xFFFFFFu);
        EXPECT_EQ(Pixel(window->Client(), 5, 600), Rgb(window->BackColor()));
        window->PagePanel1()->SetValue(2);
        for (long long i = 0; i <= 8; ++i) {
            if (i <= 7) {
                ExpectReadable(Shown(window, *window->Label5(i)), "Label5");
            }
            ExpectReadable(Shown(window, *window->Label6(i)), "Label6(" + std::to_string(i) + ")");
        }
        ExpectReadable(Shown(window, *window->Label4()), "Label4");
        for (long long tab : {1, 0}) {
            window->TabPanel1()->SetValue(tab);
            const QImage inside = Inside(*(tab == 0 ? window->TextArea1() : window->TextArea2()));
            EXPECT_EQ(Ground(inside), desktop.color(QPalette::Base).rgb()) << "the desktop's";
            ExpectReadable(inside, "TextArea");
        }

        window->PagePanel1()->SetValue(1);
        ExpectReadable(Shown(window, *window->Label3()), "Label3");
        EXPECT_EQ(Stripe(window, 0), dark ? qRgb(22, 22, 22) : qRgb(237, 243, 254));
        EXPECT_EQ(Stripe(window, 1), Rgb(window->BackColor()));
        window->PagePanel1()->SetValue(0);
        ExpectReadable(Shown(window, *window->Label1()), "Label1");
        const QImage disabled = Shown(window, *window->Label2());
        EXPECT_EQ(Ink(disabled, Ground(disabled)),
                  desktop.color(QPalette::Disabled, QPalette::WindowText).rgb())
            << "a disabled label is greyed as the desktop greys it";
    }
}

// The segments take the palette's colours at each paint, so they follow each switch both ways;
// the chosen one's title and focus ring read on its ground.
TEST_F(PortalTest, TheSegmentsFollowEachSwitchAndShowTheirFocus) {
    PrivateSessionBus::settings->scheme = kLight;
    auto window = StartUp();
    const auto segments =
        window->MainTabs()->Widget()->findChildren<QPushButton*>(Qt::FindDirectChildrenOnly);
    ASSERT_EQ(segments.size(), 2);
    QPushButton* chosen = segments[1];
    ASSERT_TRUE(chosen->isChecked());
    const QPoint ring(3, chosen->height() / 2);  // inside the border, left of the title
    for (uint scheme : {kDark, kLight, kDark, kLight}) {
        SwitchTo(window, scheme);
        const QImage other = segments[0]->grab().toImage();
        EXPECT_EQ(Ground(other), QApplication::palette().color(QPalette::Button).rgb());
        ExpectReadable(other, "Installation");
        chosen->clearFocus();
        const QImage plain = chosen->grab().toImage();
        const QRgb ground = Ground(plain);
        ExpectReadable(plain, "Verification Results");
        EXPECT_EQ(plain.pixel(ring) | 0xFF000000u, ground);

        chosen->setFocus(Qt::TabFocusReason);
        const QImage focused = chosen->grab().toImage();
        EXPECT_GE(Contrast(focused.pixel(ring), ground), kReadable) << "the focus ring shows";
    }
}

// A desktop that switches many times a second, during a list load or under an open message box:
// the window ends in the appearance that the desktop has last.
TEST_F(PortalTest, TheWindowEndsInTheAppearanceThatTheDesktopHasLast) {
    PrivateSessionBus::settings->scheme = kLight;
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
    for (int i = 0; i < 21; ++i) {
        PrivateSessionBus::Switch(i % 2 ? kLight : kDark);
    }
    endsIn(true);

    // The load holds every event back, the desktop's word too, until it has ended.
    SetYieldIntervalForTesting(std::chrono::nanoseconds(0));
    int paints = 0;
    SetYieldPaintObserverForTesting([&](auto) {
        if (++paints <= 3) {
            PrivateSessionBus::Switch(paints % 2 ? kLight : kDark);
        }
    });
    window->PagePanel1()->SetValue(1);
    SetYieldPaintObserverForTesting(nullptr);
    SetYieldIntervalForTesting(std::chrono::milliseconds(50));
    ASSERT_GT(paints, 3);
    endsIn(false);

    // A message box runs the event loop: the window follows while the box is open.
    QTimer::singleShot(0, [&] {
        for (uint scheme : {kDark, kLight, kDark}) {
            PrivateSessionBus::Switch(scheme);
        }
        EXPECT_TRUE(WaitForBackColor(window, true));
        QWidget* box = QApplication::activeModalWidget();
        ASSERT_NE(box, nullptr);
        box->close();
    });
    MsgBox("Unable to install at this time 1");
    endsIn(true);
}

// Only solid black text and a solid white ground are the desktop's; any other value, however
// close, is shown as it stands in either appearance.
TEST_F(PortalTest, AnyOtherStoredColourStaysAsItIs) {
    PrivateSessionBus::settings->scheme = kLight;
    auto window = StartUp();
    window->Label3()->SetProperty("TextColor", ColorWord{0x000001});
    window->TextArea1()->SetProperty("BackColor", ColorWord{0xF0F0F0});
    window->TextArea1()->SetProperty("TextColor", ColorWord{0x225684});
    window->TextArea1()->SetText("Bar 1 330");
    for (uint scheme : {kDark, kLight}) {
        SwitchTo(window, scheme);
        window->PagePanel1()->SetValue(1);
        const QImage hint = Shown(window, *window->Label3());
        EXPECT_EQ(Ink(hint, Ground(hint)), qRgb(0, 0, 1));
        window->PagePanel1()->SetValue(2);
        const QImage inside = Inside(*window->TextArea1());
        EXPECT_EQ(Ground(inside), qRgb(0xF0, 0xF0, 0xF0));
        // Thin strokes may cover no pixel whole, but a blend with a grey keeps the hue.
        EXPECT_NEAR(QColor(Ink(inside, Ground(inside))).hue(), QColor(0x225684).hue(), 2);
    }
}

}  // namespace
