// The window follows the appearance, read off the painted pixels: its background, the list's
// stripes, every text on its ground and the segments' focus ring, at opening and at every
// change; a change with no window open makes a new one. How the desktop's settings portal
// brings a change is met in portal_test.
#include <QAbstractScrollArea>
#include <QPushButton>

#include <algorithm>

#include "contrast.h"
#include "platform/runtime/notifications.h"
#include "window_fixture.h"

using namespace testsupport;

namespace {

// The least contrast of text on its ground that reads for a person with weaker sight.
constexpr double kReadable = 4.5;

class AppearanceTest : public WindowTest {
  protected:
    // The inside of a text pane, without its frame and scrollbar.
    static QImage Inside(const TextArea& pane) {
        ProcessEvents();
        return static_cast<QAbstractScrollArea*>(pane.Widget())->viewport()->grab().toImage();
    }
    static void ExpectReadable(const QImage& image, const std::string& what) {
        const QRgb ground = Ground(image);
        EXPECT_GE(Contrast(Ink(image, ground), ground), kReadable) << what;
    }
};

// Opened in the light (the fixture's default) the window is white; each change recolours it,
// the list's stripes and the segments, the selected row still shows, and every text takes the
// appearance's colours as the framework paints stored solid black text and a white ground: on
// the report page, the list page and the installation page.
TEST_F(AppearanceTest, EachChangeRecoloursTheWindowTheStripesAndEveryText) {
    auto window =
        StartUp({{"1", "2018", "Box.ai", "A", demo::ReportText(demo::Layout::A, "42", "EAN 8", 3)},
                 {"2", "2019", "Jar.ai", "B", "Code reads 7"},
                 {"3", "", "", "A", ""}});
    const auto segments =
        window->MainTabs()->Widget()->findChildren<QPushButton*>(Qt::FindDirectChildrenOnly);
    ASSERT_EQ(segments.size(), 2);
    QPushButton* chosen = segments[1];
    const QPoint ring(3, chosen->height() / 2);  // inside the border, left of the title
    ASSERT_TRUE(DoubleClickRow(window, 0));
    for (auto appearance :
         {Appearance::Light, Appearance::Dark, Appearance::Light, Appearance::Dark}) {
        const bool dark = appearance == Appearance::Dark;
        SCOPED_TRACE(dark ? "dark" : "light");
        SetAppearanceForTesting(appearance);
        ProcessEvents();
        const QPalette desktop = QApplication::palette();
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
        EXPECT_EQ(Stripe(window, 2), dark ? qRgb(22, 22, 22) : qRgb(237, 243, 254));
        EXPECT_EQ(Stripe(window, 1), Rgb(window->BackColor()));
        window->Listbox1()->SetListIndex(2);
        EXPECT_NE(Stripe(window, 2), dark ? qRgb(22, 22, 22) : qRgb(237, 243, 254))
            << "the selected row is marked";
        window->Listbox1()->SetListIndex(0);
        ExpectReadable(View(window).viewport()->grab(QRect(0, 0, 400, 25)).toImage(), "chosen");
        window->Listbox1()->SetListIndex(-1);

        // The segments take the palette's colours at each paint; the chosen one's title and
        // focus ring read on its ground.
        const QImage other = segments[0]->grab().toImage();
        EXPECT_EQ(Ground(other), desktop.color(QPalette::Button).rgb());
        ExpectReadable(other, "Installation");
        ASSERT_TRUE(chosen->isChecked());
        chosen->clearFocus();
        const QImage plain = chosen->grab().toImage();
        ExpectReadable(plain, "Verification Results");
        EXPECT_EQ(plain.pixel(ring) | 0xFF000000u, Ground(plain));
        chosen->setFocus(Qt::TabFocusReason);
        EXPECT_GE(Contrast(chosen->grab().toImage().pixel(ring), Ground(plain)), kReadable)
            << "the focus ring shows";

        window->PagePanel1()->SetValue(0);
        ExpectReadable(Shown(window, *window->Label1()), "Label1");
        const QImage disabled = Shown(window, *window->Label2());
        EXPECT_EQ(Ink(disabled, Ground(disabled)),
                  desktop.color(QPalette::Disabled, QPalette::WindowText).rgb())
            << "a disabled label is greyed as the desktop greys it";
    }
}

// Only solid black text and a solid white ground are the desktop's; any other value, however
// close, is shown as it stands in either appearance.
TEST_F(AppearanceTest, AnyOtherStoredColourStaysAsItIs) {
    auto window = StartUp();
    window->Label3()->SetProperty("TextColor", ColorWord{0x000001});
    window->TextArea1()->SetProperty("BackColor", ColorWord{0xF0F0F0});
    window->TextArea1()->SetProperty("TextColor", ColorWord{0x225684});
    window->TextArea1()->SetText("Bar 1 330");
    for (auto appearance : {Appearance::Dark, Appearance::Light}) {
        SetAppearanceForTesting(appearance);
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

// The desktop says that its theme and its colour preferences changed while no window is open:
// nothing happens inside its callback, and from the event loop the first change makes a new
// window, on the installation page, and the second finds that window.
TEST_F(AppearanceTest, AChangeWithoutAWindowMakesANewOneOnTheInstallationPage) {
    auto first = StartUp();
    first->Close();
    ProcessEvents();
    ASSERT_TRUE(_GetImplicitWindow("Window1.Window1").IsNil());
    SetAppearanceForTesting(Appearance::Dark);
    _MacOSDistributedNotifications::gotCalled(_MacOSDistributedNotifications::kThemeChanged);
    EXPECT_TRUE(_GetImplicitWindow("Window1.Window1").IsNil()) << "not inside the callback";
    ProcessEvents();
    EXPECT_EQ(std::ranges::count_if(QApplication::topLevelWidgets(), &QWidget::isVisible), 1);
    auto second = Cast<class Window1>(_GetImplicitWindow("Window1.Window1"));
    ASSERT_FALSE(second.IsNil());
    EXPECT_NE(second, first);
    EXPECT_EQ(second->MenuBar(), first->MenuBar()) << "the one menu bar serves every window";
    EXPECT_EQ(second->PagePanel1()->Value(), 0);
    EXPECT_TRUE(second->MainTabs()->Items()[0]->Selected());
    EXPECT_EQ(second->BackColor(), FillColor());
}

}  // namespace
