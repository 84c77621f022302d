// Pixels of the titled frame against its arithmetic: the frame L pixels thick inside
// (0, 0, W, H - L), hairlines of quarter-strength black on its outer and inner edges, the band
// of 20 rows with its hairline on the top row, the sides and row 19.
#include <QImage>
#include <QPainter>

#include <gtest/gtest.h>

#include <cmath>

#include "drawing/rect_box.h"
#include "platform/widgets/graphics.h"

namespace {

constexpr Color kColour = 0x225684;
const QRgb kGround = qRgb(255, 255, 255);
const QRgb kSolid = qRgb(Red(kColour), Green(kColour), Blue(kColour));
// Black at a quarter strength over the frame's colour.
const QRgb kHairline =
    qRgb(qRound(qRed(kSolid) * 191 / 255.0), qRound(qGreen(kSolid) * 191 / 255.0),
         qRound(qBlue(kSolid) * 191 / 255.0));

QImage Paint(long long linesize, const std::string& title, int width, int height, int ratio = 1) {
    QImage image(width * ratio, height * ratio, QImage::Format_ARGB32);
    image.setDevicePixelRatio(ratio);
    image.fill(kGround);
    RectBox box;
    box.colour = kColour;
    box.linesize = linesize;
    box.title = title;
    QPainter painter(&image);
    box.Event_Paint(New<Graphics>(painter, width, height, 0xFFFFFF), {});
    return image;
}

// A point in the frame's own pixels and the colour it must have; the ground exactly, the
// frame's colours give or take the rounding of a blend.
struct Probe {
    int x, y;
    QRgb colour;
};

struct Frame {
    long long linesize;
    std::string title;
    int width, height, ratio;
    std::vector<Probe> probes;
};

// Three thick, titled. Left side below the band: outer hairline, frame, inner hairline, ground;
// then the right inner hairline. The bottom ends at H - L, the last L rows unpainted. The band:
// hairline on its top row and right side, solid right of the title, the line on row 19 from
// L - 1, the ground below.
const std::vector<Probe> kTitled = {
    {0, 60, kHairline},   {1, 60, kSolid},       {2, 60, kHairline},   {3, 60, kGround},
    {197, 60, kHairline}, {100, 116, kHairline}, {100, 115, kSolid},   {100, 114, kHairline},
    {100, 117, kGround},  {100, 0, kHairline},   {199, 10, kHairline}, {150, 10, kSolid},
    {100, 19, kHairline}, {1, 19, kSolid},       {100, 21, kGround}};
// Untitled: four rounded corners and no band.
const std::vector<Probe> kUntitled = {
    {0, 0, kGround}, {199, 0, kGround}, {100, 1, kSolid}, {100, 10, kGround}};
// Two thick: no hairlines, a flat band, the bottom frame ends at H - L.
const std::vector<Probe> kThin = {
    {0, 60, kSolid}, {2, 60, kGround}, {100, 19, kSolid}, {100, 117, kSolid}, {100, 118, kGround}};
// As tall as a page: its sides halfway down, a rounded corner.
const std::vector<Probe> kPageSized = {{1, 300, kSolid}, {895, 300, kSolid}, {0, 516, kGround}};

const Frame kFrames[] = {
    {3, "Verification Results", 200, 120, 1, kTitled},
    {3, "", 200, 120, 1, kUntitled},
    {2, "   ", 200, 120, 1, kThin},
    {3, "Verification Results", 897, 520, 1, kPageSized},
    {3, "Verification Results", 897, 520, 2, kPageSized},  // two pixels a point
};

TEST(RectBox, EachFramePaintsItsArithmetic) {
    const auto near = [](QRgb a, QRgb b) {
        return std::abs(qRed(a) - qRed(b)) <= 2 && std::abs(qGreen(a) - qGreen(b)) <= 2 &&
               std::abs(qBlue(a) - qBlue(b)) <= 2;
    };
    for (const Frame& f : kFrames) {
        const QImage image = Paint(f.linesize, f.title, f.width, f.height, f.ratio);
        for (const Probe& p : f.probes) {
            const QRgb actual = image.pixel(p.x * f.ratio, p.y * f.ratio);
            EXPECT_TRUE(p.colour == kGround ? actual == kGround : near(actual, p.colour))
                << "frame " << &f - kFrames << " at " << p.x << ", " << p.y << ": " << std::hex
                << actual << " for " << p.colour;
        }
    }
}

// The title is white, and begins at x = 16.
TEST(RectBox, TheTitleIsWhiteFromSixteenOn) {
    const QImage band = Paint(3, "Verification Results", 200, 120).copy(0, 0, 120, 20);
    int first = band.width();
    for (int y = 0; y < band.height(); ++y) {
        for (int x = 0; x < first; ++x) {
            first = qRed(band.pixel(x, y)) > 240 && qGreen(band.pixel(x, y)) > 240 ? x : first;
        }
    }
    EXPECT_TRUE(first >= 16 && first < 24) << "first white at " << first;
}

}  // namespace
