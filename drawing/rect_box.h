// RectBox: a titled frame. A rounded frame in `colour`, `linesize` pixels thick, with a band
// across its top that carries `title` in white. It only paints.
#pragma once

#include <string>

#include "platform/core/color.h"
#include "platform/widgets/canvas.h"

class RectBox : public Canvas {
  public:
    RectBox();
    void SetProperty(const std::string& name, const PropertyValue& value) override;
    void Event_Paint(Ref<Graphics> g, const std::vector<Rect>& areas) override;

    Color colour = 0;
    long long linesize = 3;
    std::string title;
};
