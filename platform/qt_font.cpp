// Font names to Qt fonts.
#include "platform/qt_font.h"

void SetFontFamily(QFont& font, const std::string& family) {
    if (family.empty() || family == "System") {
        return;
    }
    font.setFamily(QString::fromStdString(family));
    font.setStyleHint(family == "Courier" ? QFont::TypeWriter : QFont::SansSerif);
}
