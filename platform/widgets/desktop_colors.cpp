// Stored colours over a widget's palette, where only the roles of a value that stands as it is
// are set and every other role is the application's; and a ground moved until a text reads on it.
#include "platform/widgets/desktop_colors.h"

#include <QPalette>
#include <QWidget>

#include <algorithm>
#include <cmath>

#include "platform/runtime/qt_color.h"

namespace {

constexpr Color kDesktopText = 0x000000;
constexpr Color kDesktopGround = 0xFFFFFF;
// The least contrast at which a person with weaker sight reads a text, and the step by which
// a ground is moved towards it.
constexpr double kReadable = 4.5;
constexpr int kStepPercent = 104;

// Relative luminance and contrast as the accessibility guidelines define them.
double Luminance(const QColor& colour) {
    const auto linear = [](double c) {
        return c <= 0.04045 ? c / 12.92 : std::pow((c + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * linear(colour.redF()) + 0.7152 * linear(colour.greenF()) +
           0.0722 * linear(colour.blueF());
}

double Contrast(const QColor& a, const QColor& b) {
    const double la = Luminance(a), lb = Luminance(b);
    return (std::max(la, lb) + 0.05) / (std::min(la, lb) + 0.05);
}

}  // namespace

void ShowStoredColors(QWidget& widget, const PropertyObject& control) {
    // An empty palette: each role that is not set here is the application's, now and after
    // each change of it.
    QPalette palette;
    if (const Color text = control.PropertyOr("TextColor", ColorWord{kDesktopText}).value;
        text != kDesktopText) {
        // Active and inactive only: a disabled control keeps the desktop's greyed text.
        for (auto group : {QPalette::Active, QPalette::Inactive}) {
            palette.setColor(group, QPalette::WindowText, ToQColor(text));
            palette.setColor(group, QPalette::Text, ToQColor(text));
        }
    }
    if (const Color back = control.PropertyOr("BackColor", ColorWord{kDesktopGround}).value;
        back != kDesktopGround) {
        palette.setColor(QPalette::Base, ToQColor(back));
    }
    widget.setPalette(palette);
}

QColor ReadableGround(QColor ground, const QColor& text) {
    const bool darken = Luminance(text) > Luminance(ground);
    // Black and white are the ends: there the contrast is as high as it can be.
    for (int step = 0; step < 100 && Contrast(ground, text) < kReadable; ++step) {
        const QColor next = darken ? ground.darker(kStepPercent) : ground.lighter(kStepPercent);
        if (next == ground) {
            break;
        }
        ground = next;
    }
    return ground;
}
