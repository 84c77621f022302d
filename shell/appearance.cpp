// The window's background follows the desktop's light or dark appearance: at opening, and at
// every change the desktop reports.
#include "platform/runtime/appearance.h"
#include "shell/app.h"
#include "shell/window1.h"

namespace {
constexpr Color kLightBackground = 0xFFFFFF;
}

// In the light appearance the window keeps the white of its properties.
void Window1::Event_Open() {
    if (IsDarkMode()) {
        SetBackColor(FillColor());
    }
}

void App::Event_AppearanceChanged() {
    if (IsDarkMode()) {
        Window1()->SetBackColor(FillColor());
    } else {
        Window1()->SetBackColor(kLightBackground);
    }
}
