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

constexpr int W = 200;
constexpr int H = 120;
constexpr Color kColour = 0x225684;
const QRgb kGround = qRgb(255, 255, 255);

QImage Paint(long long linesize, const std::string& title, int width = W, int height = H,
             int ratio = 1) {
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

QRgb Solid() {
    return qRgb(Red(kColour), Green(kColour), Blue(kColour));
}

// Black at a quarter strength over the frame's colour.
QRgb Hairline(QRgb under) {
    auto dim = [](int c) { return static_cast<int>(c * 191 / 255.0 + 0.5); };
    return qRgb(dim(qRed(under)), dim(qGreen(under)), dim(qBlue(under)));
}

void ExpectNear(QRgb actual, QRgb expected, const char* where) {
    EXPECT_LE(std::abs(qRed(actual) - qRed(expected)), 2) << where;
    EXPECT_LE(std::abs(qGreen(actual) - qGreen(expected)), 2) << where;
    EXPECT_LE(std::abs(qBlue(actual) - qBlue(expected)), 2) << where;
}

TEST(RectBox, FrameOfThreeWithTitle) {
    const QImage image = Paint(3, "Verification Results");
    const int mid = W / 2;
    const int y = 60;
    // Left side below the band: outer hairline, frame, inner hairline, then the ground.
    ExpectNear(image.pixel(0, y), Hairline(Solid()), "outer hairline");
    ExpectNear(image.pixel(1, y), Solid(), "frame");
    ExpectNear(image.pixel(2, y), Hairline(Solid()), "inner hairline");
    EXPECT_EQ(image.pixel(3, y), kGround);
    ExpectNear(image.pixel(W - 3, y), Hairline(Solid()), "right inner hairline");
    // Bottom: the frame ends at H - L; the last L rows stay unpainted.
    ExpectNear(image.pixel(mid, H - 4), Hairline(Solid()), "bottom outer hairline");
    ExpectNear(image.pixel(mid, H - 5), Solid(), "bottom frame");
    ExpectNear(image.pixel(mid, H - 6), Hairline(Solid()), "bottom inner hairline");
    EXPECT_EQ(image.pixel(mid, H - 3), kGround);
    // The band: hairline on its top row, solid inside, and the line on row 19.
    ExpectNear(image.pixel(mid, 0), Hairline(Solid()), "band top hairline");
    ExpectNear(image.pixel(W - 1, 10), Hairline(Solid()), "band right hairline");
    ExpectNear(image.pixel(150, 10), Solid(), "band right of the title");
    ExpectNear(image.pixel(mid, 19), Hairline(Solid()), "row 19 line");
    ExpectNear(image.pixel(1, 19), Solid(), "row 19 starts at L - 1");
    EXPECT_EQ(image.pixel(mid, 21), kGround);
    // The title: white pixels between x = 16 and the band's bottom.
    bool white = false;
    for (int x = 16; x < 120 && !white; ++x) {
        for (int yy = 3; yy <= 16 && !white; ++yy) {
            white = qRed(image.pixel(x, yy)) > 240 && qGreen(image.pixel(x, yy)) > 240;
        }
    }
    EXPECT_TRUE(white);
    for (int yy = 0; yy < 20; ++yy) {
        EXPECT_LT(qRed(image.pixel(10, yy)), 200) << "nothing white before x = 16, row " << yy;
    }
}

TEST(RectBox, FrameOfThreeWithoutTitleKeepsFourRoundedCorners) {
    const QImage image = Paint(3, "");
    EXPECT_EQ(image.pixel(0, 0), kGround) << "rounded top-left corner";
    EXPECT_EQ(image.pixel(W - 1, 0), kGround);
    ExpectNear(image.pixel(W / 2, 1), Solid(), "top frame");
    EXPECT_EQ(image.pixel(W / 2, 10), kGround) << "no band";
}

TEST(RectBox, FrameOfTwoHasNoHairlinesAndAFlatBand) {
    const QImage image = Paint(2, "   ");
    ExpectNear(image.pixel(0, 60), Solid(), "frame");
    EXPECT_EQ(image.pixel(2, 60), kGround);
    ExpectNear(image.pixel(W / 2, 19), Solid(), "band bottom");
    ExpectNear(image.pixel(W / 2, H - 3), Solid(), "bottom frame ends at H - L");
    EXPECT_EQ(image.pixel(W / 2, H - 2), kGround);
}

// A frame as tall as a page, at one and two pixels a point.
TEST(RectBox, PageSizedFrameHasItsSidesAndRoundedCorners) {
    for (const int ratio : {1, 2}) {
        const QImage image = Paint(3, "Verification Results", 897, 520, ratio);
        ExpectNear(image.pixel(1 * ratio, 300 * ratio), Solid(), "left side, halfway down");
        ExpectNear(image.pixel(895 * ratio, 300 * ratio), Solid(), "right side, halfway down");
        EXPECT_EQ(image.pixel(0, 516 * ratio), kGround) << "rounded bottom corner";
    }
}

}  // namespace
