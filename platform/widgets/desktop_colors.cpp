// Stored colours over a widget's palette: only the roles of a value that stands as it is are
// set, and every other role comes from the application's palette.
#include "platform/widgets/desktop_colors.h"

#include <QPalette>
#include <QWidget>

#include <optional>

#include "platform/runtime/qt_color.h"

namespace {

constexpr Color kDesktopText = 0x000000;
constexpr Color kDesktopGround = 0xFFFFFF;

std::optional<Color> StoredColor(const PropertyObject& control, const char* name) {
    const PropertyValue* value = control.Property(name);
    if (!value || !std::holds_alternative<ColorWord>(*value)) {
        return std::nullopt;
    }
    return std::get<ColorWord>(*value).value;
}

}  // namespace

void ShowStoredColors(QWidget& widget, const PropertyObject& control) {
    // An empty palette: each role that is not set here is the application's, now and after
    // each change of it.
    QPalette palette;
    if (const auto text = StoredColor(control, "TextColor"); text && *text != kDesktopText) {
        // Active and inactive only: a disabled control keeps the desktop's greyed text.
        for (auto group : {QPalette::Active, QPalette::Inactive}) {
            palette.setColor(group, QPalette::WindowText, ToQColor(*text));
            palette.setColor(group, QPalette::Text, ToQColor(*text));
        }
    }
    if (const auto back = StoredColor(control, "BackColor"); back && *back != kDesktopGround) {
        palette.setColor(QPalette::Base, ToQColor(*back));
    }
    widget.setPalette(palette);
}
