// Colour words to Qt colours and back.
#include "platform/runtime/qt_color.h"

#include <algorithm>
#include <cmath>

QColor ToQColor(Color color, double transparency) {
    const double opacity = 1.0 - std::clamp(transparency, 0.0, 100.0) / 100.0;
    const double wordOpacity = 1.0 - Transparency(color) / 255.0;
    return QColor(Red(color), Green(color), Blue(color),
                  static_cast<int>(std::lround(255.0 * opacity * wordOpacity)));
}

Color FromQColor(const QColor& color) {
    return RGB(color.red(), color.green(), color.blue());
}
