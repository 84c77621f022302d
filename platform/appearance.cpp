// Appearance over Qt's application palette.
#include "platform/appearance.h"

#include <QApplication>
#include <QPalette>
#include <QStyle>

#include "platform/qt_color.h"

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
}  // namespace

bool IsDarkMode() {
    return QApplication::palette().color(QPalette::Window).lightness() < kMiddleLightness;
}

Color FillColor() {
    return FromQColor(QApplication::palette().color(QPalette::Window));
}

void SetAppearanceForTesting(Appearance appearance) {
    QApplication::setPalette(
        appearance == Appearance::Dark ? DarkPalette() : QApplication::style()->standardPalette());
}
