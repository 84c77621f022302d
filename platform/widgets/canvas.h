// Canvas: a control that draws itself in its Paint event, with a fresh Graphics each time.
#pragma once

#include <vector>

#include "platform/widgets/control.h"
#include "platform/widgets/graphics.h"

struct Rect {
    int left = 0, top = 0, width = 0, height = 0;
};

class Canvas : public Control {
  public:
    Canvas();
    void DetachWidget() override;
    // The Paint event: `g` covers the whole control, `areas` are the parts to redraw.
    virtual void Event_Paint(Ref<Graphics> g, const std::vector<Rect>& areas);
};
