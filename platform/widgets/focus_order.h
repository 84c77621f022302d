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
// The control whose widget is or holds `widget`; nullptr for none.
const Control* OwnerOf(const std::vector<Ref<Control>>& controls, const QWidget* widget);
// Gives the focus to the first widget in the keyboard order that belongs to one of `among`.
void FocusFirstOf(const std::vector<Ref<Control>>& controls,
                  const std::vector<const Control*>& among);
