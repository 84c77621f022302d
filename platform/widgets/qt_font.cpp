// Font names to Qt fonts.
#include "platform/widgets/qt_font.h"

#include <QFont>

#include "platform/core/text.h"

void SetFontFamily(QFont& font, const std::string& family) {
    if (family.empty() || family == "System") {
        return;
    }
    font.setFamily(QString::fromStdString(family));
    // Fontconfig knows Courier's stand-ins by its name alone, and falls back to a monospaced
    // face after them; with a typewriter hint, Qt may take the desktop's monospaced face
    // before them, whose wider letters reflow the report's columns.
    if (!TextEquals(family, "Courier")) {
        font.setStyleHint(QFont::SansSerif);
    }
}
