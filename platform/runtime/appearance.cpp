// Appearance over Qt's application palette; where the desktop's theme gives no dark palette,
// a dark one of our own stands in.
#include "platform/runtime/appearance.h"

#include <QApplication>
#include <QPalette>
#include <QStyle>

#include "platform/runtime/qt_color.h"

namespace {
constexpr int kMiddleLightness = 128;

// Every role of every group is set: a role left out would keep the light palette's colour.
// Its texts read at 8:1 or more on their grounds, and its disabled text is greyed.
QPalette DarkPalette() {
    const QColor window(0x32, 0x32, 0x32);
    const QColor base(0x1E, 0x1E, 0x1E);
    const QColor button(0x3C, 0x3C, 0x3C);
    const QColor text(0xE6, 0xE6, 0xE6);
    const QColor disabledText(0x80, 0x80, 0x80);
    QPalette p(text, button, button.lighter(150), button.darker(200), button.lighter(125), text,
               Qt::white, base, window);
    p.setColor(QPalette::Midlight, button.lighter(125));
    p.setColor(QPalette::Shadow, Qt::black);
    p.setColor(QPalette::AlternateBase, window);
    p.setColor(QPalette::ButtonText, text);
    p.setColor(QPalette::Highlight, QColor(0x2A, 0x62, 0xC9));
    p.setColor(QPalette::HighlightedText, Qt::white);
    p.setColor(QPalette::Link, QColor(0x7A, 0xB0, 0xFF));
    p.setColor(QPalette::LinkVisited, QColor(0xB8, 0x94, 0xFF));
    p.setColor(QPalette::ToolTipBase, base);
    p.setColor(QPalette::ToolTipText, text);
    p.setColor(QPalette::PlaceholderText, disabledText);
    for (auto role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText}) {
        p.setColor(QPalette::Disabled, role, disabledText);
    }
    p.setColor(QPalette::Disabled, QPalette::Base, window);
    p.setColor(QPalette::Disabled, QPalette::Highlight, QColor(0x50, 0x50, 0x50));
    return p;
}

QPalette PaletteFor(Appearance appearance) {
    return appearance == Appearance::Dark ? DarkPalette()
                                          : QApplication::style()->standardPalette();
}
}  // namespace

bool IsDarkMode() {
    return QApplication::palette().color(QPalette::Window).lightness() < kMiddleLightness;
}

Color FillColor() {
    return FromQColor(QApplication::palette().color(QPalette::Window));
}

// A palette that already is light or dark, as the desktop's own theme may have made it, stays.
void FollowDesktopAppearance(Appearance appearance) {
    if ((appearance == Appearance::Dark) != IsDarkMode()) {
        QApplication::setPalette(PaletteFor(appearance));
    }
}

void SetAppearanceForTesting(Appearance appearance) {
    QApplication::setPalette(PaletteFor(appearance));
}
