// Font names to Qt fonts.
#include "platform/qt_font.h"

#include <QFontDatabase>
#include <QStringList>

#include "platform/text.h"

namespace {

// The first of `names` that this desktop has, or the first name if it has none of them.
QString FirstInstalled(const QStringList& names) {
    const QStringList families = QFontDatabase::families();
    for (const QString& name : names) {
        if (families.contains(name, Qt::CaseInsensitive)) {
            return name;
        }
    }
    return names.first();
}

// Most Linux desktops have neither Arial nor Courier. Fontconfig gives their metric twins in
// their place, but Qt asks for a twin only after sorting every installed font into a fallback
// list, which costs a start-up about a millisecond, and with the typewriter hint it may settle
// on another monospaced face, whose wider letters would reflow the report's columns. The twin
// asked for by name is the face that fontconfig means, found at once.
QString InstalledFamily(const std::string& family) {
    if (TextEquals(family, "Arial")) {
        static const QString arial = FirstInstalled({"Arial", "Liberation Sans", "Arimo"});
        return arial;
    }
    if (TextEquals(family, "Courier")) {
        static const QString courier =
            FirstInstalled({"Courier", "Courier New", "Liberation Mono", "Cousine"});
        return courier;
    }
    return QString::fromStdString(family);
}

}  // namespace

void SetFontFamily(QFont& font, const std::string& family) {
    if (family.empty() || family == "System") {
        return;
    }
    font.setFamily(InstalledFamily(family));
    font.setStyleHint(family == "Courier" ? QFont::TypeWriter : QFont::SansSerif);
}
