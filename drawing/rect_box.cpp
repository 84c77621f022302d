// RectBox painting. Every call on the Graphics is in the order in which the frame was
// designed; the hairlines are a quarter-strength black over the frame's edges.
#include "drawing/rect_box.h"

#include "platform/core/property_block.h"

namespace {
constexpr double kArc = 14;
constexpr double kInnerArc = 12;
constexpr double kBandHeight = 20;
constexpr double kHairlineTransparency = 75.0;
constexpr Color kBlack = 0x000000;
constexpr double kTitleX = 16;
constexpr double kTitleBaseline = 14;
constexpr float kTitleSize = 12.0f;

// Hairlines come only with a frame thicker than 2.
bool HasHairlines(long long linesize) {
    return linesize > 2;
}

void UseHairline(Graphics& g) {
    g.Transparency = kHairlineTransparency;
    g.ForeColor = kBlack;
    g.PenWidth = 1.0;
    g.PenHeight = 1.0;
}

void DrawFrame(Graphics& g, Color colour, long long L, long long W, long long H) {
    g.ForeColor = colour;
    g.PenHeight = static_cast<double>(L);
    g.PenWidth = static_cast<double>(L);
    // The bottom L rows stay unpainted.
    g.DrawRoundRect(0, 0, W, H - L, kArc, kArc);
    if (HasHairlines(L)) {
        UseHairline(g);
        g.DrawRoundRect(0, 0, W, H - L, kArc, kArc);
        g.DrawRoundRect(L - 1, L - 1, W - 2 * L + 2, H - 3 * L + 2, kInnerArc, kInnerArc);
    }
}

void DrawBand(Graphics& g, Color colour, long long L, long long W) {
    g.ClearRect(0, 0, W, kBandHeight);
    g.Transparency = 0.0;
    g.ForeColor = colour;
    g.FillRect(0, 0, W, kBandHeight);
    if (HasHairlines(L)) {
        UseHairline(g);
        g.DrawRect(0, 0, W, kBandHeight);
    }
    // Repaints the inside and the last row, so the outline stays on the top row and sides.
    g.Transparency = 0.0;
    g.ForeColor = colour;
    g.FillRect(1, 1, W - 2, kBandHeight - 1);
    if (HasHairlines(L)) {
        UseHairline(g);
        g.DrawLine(L - 1, kBandHeight - 1, W - L, kBandHeight - 1);
    }
}

void DrawTitle(Graphics& g, const std::string& title) {
    g.Transparency = 0.0;
    g.ForeColor = RGB(255, 255, 255, 0);
    g.Bold = true;
    g.TextFont = "Arial";
    g.TextSize = kTitleSize;
    // A fixed place: the title is neither measured, nor wrapped, nor shortened.
    g.DrawString(title, kTitleX, kTitleBaseline, 0, false);
}

}  // namespace

// The frame's own properties are known once the first frame exists, before any block for it
// is built or read.
RectBox::RectBox() {
    static const bool registered = [] {
        RegisterProperty("colour", PropertyType::Colour);
        RegisterProperty("linesize", PropertyType::Integer);
        RegisterProperty("title", PropertyType::String);
        return true;
    }();
    (void)registered;
}

void RectBox::SetProperty(const std::string& name, const PropertyValue& value) {
    Canvas::SetProperty(name, value);
    if (name == "colour") {
        colour = std::get<ColorWord>(value).value;
    } else if (name == "linesize") {
        linesize = std::get<long long>(value);
    } else if (name == "title") {
        title = std::get<std::string>(value);
        // A screen reader names the frame by its title.
        SetAccessibleName(title);
    }
}

// Paints the whole control whatever the areas; a failure leaves what is painted so far.
void RectBox::Event_Paint(Ref<Graphics> g, const std::vector<Rect>&) {
    try {
        const long long W = g->Width();
        const long long H = g->Height();
        DrawFrame(*g, colour, linesize, W, H);
        if (title.empty()) {
            return;
        }
        DrawBand(*g, colour, linesize, W);
        DrawTitle(*g, title);
    } catch (...) {
    }
}
