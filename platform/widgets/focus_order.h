// The keyboard order of a window's controls: Tab and Shift+Tab follow the TabIndex of each
// control among its siblings, from the window down through its containers.
#pragma once

#include <vector>

#include "platform/widgets/control.h"

class QWidget;

// The widgets that Tab visits among the controls now shown, in order.
std::vector<QWidget*> FocusOrder(const std::vector<Ref<Control>>& controls);
// Moves the focus to the next or previous of them, round the ends; false if there is none.
bool MoveFocus(const std::vector<Ref<Control>>& controls, bool forward);
