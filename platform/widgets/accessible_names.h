// What a screen reader says of a control that has no words of its own for it: a control on a
// tab is named by the tab's title, and a label is the caption of the control that stands next
// to it on the right, on the same row.
#pragma once

#include <vector>

#include "platform/widgets/control.h"

// Names and captions the controls, once their widgets are built: places and tab titles do
// not change after that.
void NameByNeighbours(const std::vector<Ref<Control>>& controls);
