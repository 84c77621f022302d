// The two questions about the desktop's appearance, and a seam that switches it in tests.
#pragma once

#include "platform/core/color.h"

// True while the desktop shows its dark appearance: its window colour is darker than middle.
bool IsDarkMode();
// The desktop's current window background colour.
Color FillColor();

enum class Appearance { Light, Dark };
// Puts the whole application into the light or dark palette that the desktop asks for.
void FollowDesktopAppearance(Appearance appearance);
// The same, as a desktop change would come, with the notifications that such a change brings.
void SetAppearanceForTesting(Appearance appearance);
