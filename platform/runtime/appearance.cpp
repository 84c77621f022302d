// Appearance over Qt's application palette; where the desktop's theme gives no dark palette,
// a dark one of our own stands in.
#include "platform/runtime/appearance.h"

#include <QApplication>
#include <QPalette>
#include <QStyle>

#include "platform/runtime/qt_color.h"

namespace {
constexpr int kMiddleLightness = 128;

QPalette DarkPalette() {
    QPalette p;
    const QColor window(0x32, 0x32, 0x32);
    const QColor base(0x1E, 0x1E, 0x1E);
    const QColor text(0xE6, 0xE6, 0xE6);
    p.setColor(QPalette::Window, window);
    p.setColor(QPalette::WindowText, text);
    p.setColor(QPalette::Base, base);
    p.setColor(QPalette::AlternateBase, window);
    p.setColor(QPalette::Text, text);
    p.setColor(QPalette::Button, window);
    p.setColor(QPalette::ButtonText, text);
    p.setColor(QPalette::Highlight, QColor(0x2A, 0x62, 0xC9));
    p.setColor(QPalette::HighlightedText, Qt::white);
    p.setColor(QPalette::ToolTipBase, base);
    p.setColor(QPalette::ToolTipText, text);
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
