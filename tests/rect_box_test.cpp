// Pixels of the titled frame against its arithmetic: the frame L pixels thick inside
// (0, 0, W, H - L), hairlines of quarter-strength black on its outer and inner edges, the band
// of 20 rows with its hairline on the top row, the sides and row 19. And the rounded frame,
// painted in pieces, against the whole ring.
#include <QImage>
#include <QPainter>
#include <QPainterPath>
#include <QThreadPool>

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <iterator>

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

// The process keeps to one thread: Qt's raster engine would hand the blends of a frame as tall
// as a page to threads of its own and wait for them.
TEST(RectBox, PageSizedFramePaintsOnTheCallingThreadAlone) {
    const std::filesystem::path tasks = "/proc/self/task";
    if (!std::filesystem::exists(tasks)) {
        GTEST_SKIP() << "threads are counted in /proc";
    }
    const auto threads = [&] {
        return std::distance(std::filesystem::directory_iterator(tasks),
                             std::filesystem::directory_iterator());
    };
    QThreadPool::globalInstance()->waitForDone();  // threads that earlier paints started end
    const auto before = threads();
    const QImage image = Paint(3, "Verification Results", 897, 520);
    EXPECT_EQ(threads(), before);
    Paint(3, "Verification Results", 897, 520, 2);
    EXPECT_EQ(threads(), before) << "on a screen of two pixels a point";
    ExpectNear(image.pixel(1, 300), Solid(), "left side, halfway down");
    ExpectNear(image.pixel(895, 300), Solid(), "right side, halfway down");
    EXPECT_EQ(image.pixel(0, 516), kGround) << "rounded bottom corner";
}

// The frame is filled in pieces: rectangles for its sides, its corners from their own rows.
// Together they cover exactly the pixels of the whole ring filled at once.
TEST(RectBox, RoundedFrameInPiecesCoversTheSamePixelsAsTheWholeRing) {
    struct Case {
        double x, y, width, height, arc, pen, transparency;
    };
    const Case cases[] = {{0, 0, 897, 517, 14, 3, 0},   {0, 0, 897, 517, 14, 1, 75},
                          {2, 2, 893, 511, 12, 1, 75},  {9, 13, 239, 168, 27, 6, 0},
                          {0, 0, 40, 30, 14, 3, 30},    {4, 0, 55, 29, 10, 5, 0},
                          {0, 0, 300, 200, 100, 10, 20}};
    for (const int ratio : {1, 2}) {
        for (const Case& c : cases) {
            QImage pieces(920 * ratio, 540 * ratio, QImage::Format_ARGB32_Premultiplied);
            pieces.setDevicePixelRatio(ratio);
            pieces.fill(kGround);
            QImage whole = pieces;
            {
                QPainter painter(&pieces);
                Graphics g(painter, 920, 540, 0xFFFFFF);
                g.ForeColor = kColour;
                g.PenWidth = g.PenHeight = c.pen;
                g.Transparency = c.transparency;
                g.DrawRoundRect(c.x, c.y, c.width, c.height, c.arc, c.arc);
            }
            {
                QPainterPath ring;
                ring.setFillRule(Qt::OddEvenFill);
                ring.addRoundedRect(QRectF(c.x, c.y, c.width, c.height), c.arc / 2, c.arc / 2);
                ring.addRoundedRect(
                    QRectF(c.x + c.pen, c.y + c.pen, c.width - 2 * c.pen, c.height - 2 * c.pen),
                    std::max(0.0, c.arc / 2 - c.pen), std::max(0.0, c.arc / 2 - c.pen));
                QPainter painter(&whole);
                painter.setRenderHint(QPainter::Antialiasing);
                const QColor colour(
                    Red(kColour), Green(kColour), Blue(kColour),
                    static_cast<int>(std::lround(255 * (1 - c.transparency / 100))));
                painter.fillPath(ring, colour);
            }
            EXPECT_TRUE(pieces == whole) << c.width << "x" << c.height << " arc " << c.arc
                                         << " pen " << c.pen << " at ratio " << ratio;
        }
    }
}

}  // namespace
