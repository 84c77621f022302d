// Font names to Qt fonts.
#include "platform/widgets/qt_font.h"

#include <QFontDatabase>
#include <QStringList>

#include "platform/core/text.h"

namespace {

// Most Linux desktops have no Arial. Fontconfig gives its metric twin in its place, but Qt
// asks for it only after sorting every installed font into a fallback list, which costs a
// start-up about a millisecond. The twin asked for by name is the same face, found at once.
QString InstalledFamily(const std::string& family) {
    const QString name = QString::fromStdString(family);
    if (!TextEquals(family, "Arial")) {
        return name;
    }
    static const QString installed = [&name] {
        const QStringList families = QFontDatabase::families();
        if (families.contains(name, Qt::CaseInsensitive)) {
            return name;
        }
        for (const char* twin : {"Liberation Sans", "Arimo"}) {
            if (families.contains(twin, Qt::CaseInsensitive)) {
                return QString(twin);
            }
        }
        return name;
    }();
    return installed;
}

}  // namespace

void SetFontFamily(QFont& font, const std::string& family) {
    if (family.empty() || family == "System") {
        return;
    }
    font.setFamily(InstalledFamily(family));
    // Fontconfig knows Courier's stand-ins by its name alone, and falls back to a monospaced
    // face after them; with a typewriter hint, Qt may take the desktop's monospaced face
    // before them, whose wider letters reflow the report's columns.
    if (!TextEquals(family, "Courier")) {
        font.setStyleHint(QFont::SansSerif);
    }
}
