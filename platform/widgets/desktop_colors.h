// The colours that a control keeps, shown as the desktop framework shows them to an application
// that follows the light or dark appearance.
#pragma once

#include "platform/core/property_block.h"

class QColor;
class QWidget;

// Gives the widget the control's TextColor and BackColor. Solid black text is the desktop's
// own: its label colour on a label, its text colour on any other control; a solid white ground
// is the desktop's text background. Any other value is shown as it stands. The desktop's
// colours are left to the application's palette, which every widget takes as it paints, so a
// change of appearance recolours them all at once.
void ShowStoredColors(QWidget& widget, const PropertyObject& control);

// The ground made darker or lighter, as little as it takes, for the text to read on it at
// 4.5:1: a desktop's selection colour may be too light for white text.
QColor ReadableGround(QColor ground, const QColor& text);
