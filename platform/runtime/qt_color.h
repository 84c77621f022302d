// The one crossing between our colour words and Qt's colours.
#pragma once

#include <QColor>

#include "platform/core/color.h"

// `transparency` is a Graphics transparency, 0 (opaque) to 100, on top of the word's own.
QColor ToQColor(Color color, double transparency = 0.0);
// Opaque: the alpha of a Qt colour has no place in a colour word.
Color FromQColor(const QColor& color);
