// Graphics over QPainter, with the inward outline rule worked out in filled shapes.
#include "platform/widgets/graphics.h"

#include <QFont>
#include <QPainter>
#include <QPainterPath>

#include <algorithm>
#include <array>
#include <cmath>
#include <optional>

#include "platform/runtime/qt_color.h"
#include "platform/widgets/qt_font.h"

namespace {
bool IsWhole(double value) {
    return std::floor(value) == value;
}

// Whether whole numbers land on whole device pixels: no rotation, whole scales and shifts.
bool KeepsWholePixels(const QTransform& transform) {
    return transform.type() <= QTransform::TxScale && IsWhole(transform.m11()) &&
           IsWhole(transform.m22()) && IsWhole(transform.dx()) && IsWhole(transform.dy());
}

// The part of a closed outline between the rows `top` and `bottom`, closed along them. In
// those rows it has the same edges as the whole outline, so it covers the same pixels there,
// and the rasteriser walks only those rows, where the whole outline would cost as many as it
// is tall. Only a vertical line may cross `top` or `bottom`; for any other outline there is
// no such part. A point within kGrain of a row counts as on it: far less than the 1/64 of a
// device pixel that the rasteriser rounds points to, it only absorbs rounding errors.
std::optional<QPainterPath> RowsOf(const QPainterPath& outline, double top, double bottom) {
    constexpr double kGrain = 1.0 / 1024;
    const auto same = [](double a, double b) { return std::abs(a - b) <= kGrain; };
    QPainterPath part;
    part.setFillRule(outline.fillRule());
    bool open = false;
    QPointF first, current;
    // Pieces join along the edge of the rows, where a line has no height in them.
    const auto joins = [&](QPointF to) {
        return current == to ||
               (same(current.y(), to.y()) && (same(to.y(), top) || same(to.y(), bottom)));
    };
    const auto closePart = [&] {
        if (!open) {
            return true;
        }
        open = false;
        if (!joins(first)) {
            return false;
        }
        part.lineTo(first);
        part.closeSubpath();
        return true;
    };
    QPointF start;
    for (int i = 0; i < outline.elementCount(); ++i) {
        const QPainterPath::Element e = outline.elementAt(i);
        if (e.isMoveTo()) {
            if (!closePart()) {
                return std::nullopt;
            }
            start = e;
            continue;
        }
        std::array<QPointF, 4> points{start, e};
        std::size_t count = 2;
        if (e.isCurveTo()) {
            if (i + 2 >= outline.elementCount()) {
                return std::nullopt;
            }
            points[2] = outline.elementAt(++i);
            points[3] = outline.elementAt(++i);
            count = 4;
        }
        const auto [low, high] =
            std::minmax_element(points.begin(), points.begin() + count,
                                [](QPointF a, QPointF b) { return a.y() < b.y(); });
        const double lowest = low->y();
        const double highest = high->y();
        QPointF from = points[0];
        QPointF to = points[count - 1];
        start = to;
        if (highest <= top + kGrain || lowest >= bottom - kGrain) {
            continue;  // nothing of it in the rows
        }
        if (lowest < top - kGrain || highest > bottom + kGrain) {
            if (count != 2 || from.x() != to.x()) {
                return std::nullopt;
            }
            from.setY(std::clamp(from.y(), top, bottom));
            to.setY(std::clamp(to.y(), top, bottom));
        }
        if (!open) {
            part.moveTo(from);
            first = current = from;
            open = true;
        } else if (!joins(from)) {
            return std::nullopt;
        } else if (current != from) {
            part.lineTo(from);
        }
        if (count == 4) {
            part.cubicTo(points[1], points[2], to);
        } else {
            part.lineTo(to);
        }
        current = to;
    }
    if (!closePart()) {
        return std::nullopt;
    }
    return part;
}
}  // namespace

Graphics::Graphics(QPainter& painter, int width, int height, Color ground)
    : painter_(painter), width_(width), height_(height), ground_(ground) {
    painter_.setRenderHint(QPainter::Antialiasing, false);
}

void Graphics::ClearRect(double x, double y, double width, double height) {
    painter_.save();
    painter_.setCompositionMode(QPainter::CompositionMode_Source);
    painter_.fillRect(QRectF(x, y, width, height), ToQColor(ground_, 0.0));
    painter_.restore();
}

void Graphics::FillRect(double x, double y, double width, double height) {
    painter_.fillRect(QRectF(x, y, width, height), ToQColor(ForeColor, Transparency));
}

void Graphics::DrawRect(double x, double y, double width, double height) {
    const double pw = std::min(PenWidth, width / 2);
    const double ph = std::min(PenHeight, height / 2);
    const QColor color = ToQColor(ForeColor, Transparency);
    painter_.fillRect(QRectF(x, y, width, ph), color);
    painter_.fillRect(QRectF(x, y + height - ph, width, ph), color);
    FillRows(QRectF(x, y + ph, pw, height - 2 * ph), color);
    FillRows(QRectF(x + width - pw, y + ph, pw, height - 2 * ph), color);
}

void Graphics::DrawRoundRect(double x, double y, double width, double height, double arcWidth,
                             double arcHeight) {
    const double pw = std::min(PenWidth, width / 2);
    const double ph = std::min(PenHeight, height / 2);
    QPainterPath ring;
    ring.setFillRule(Qt::OddEvenFill);
    ring.addRoundedRect(QRectF(x, y, width, height), arcWidth / 2, arcHeight / 2);
    ring.addRoundedRect(QRectF(x + pw, y + ph, width - 2 * pw, height - 2 * ph),
                        std::max(0.0, arcWidth / 2 - pw), std::max(0.0, arcHeight / 2 - ph));
    const QColor color = ToQColor(ForeColor, Transparency);
    painter_.save();
    painter_.setRenderHint(QPainter::Antialiasing, true);
    // Below the top corners and above the bottom ones, on whole pixels, each side of the ring
    // is a column of fully covered pixels: filled as rectangles, the tall sides give the same
    // pixels without going through the blend of many spans (see FillRows).
    const double corner = std::ceil(std::max(std::min(arcHeight / 2, height / 2), ph));
    if (width > 0 && pw >= 0 && ph >= 0 && IsWhole(x) && IsWhole(y) && IsWhole(width) &&
        IsWhole(height) && IsWhole(pw) && 2 * corner < height &&
        KeepsWholePixels(painter_.deviceTransform())) {
        // Each band of corners is filled from its own rows of the ring, a few device rows at
        // a time.
        const double step = RowsOnDevice(kCornerRows);
        for (const double top : {y, y + height - corner}) {
            const auto band = RowsOf(ring, top, top + corner);
            for (double row = 0; row < corner; row += step) {
                painter_.save();
                painter_.setClipRect(QRectF(x, top + row, width, std::min(step, corner - row)),
                                     Qt::IntersectClip);
                painter_.fillPath(band ? *band : ring, color);
                painter_.restore();
            }
        }
        painter_.setRenderHint(QPainter::Antialiasing, false);
        FillRows(QRectF(x, y + corner, pw, height - 2 * corner), color);
        FillRows(QRectF(x + width - pw, y + corner, pw, height - 2 * corner), color);
    } else {
        painter_.fillPath(ring, color);
    }
    painter_.restore();
}

// Qt's raster engine hands any blend of more than 95 spans, rows for a rectangle, to its thread
// pool and waits for the threads: for a translucent side as tall as a page, that is a thread
// start and several hand-offs in a single paint, slower than blending on this thread. An opaque
// rectangle is a plain fill and needs no such care.
void Graphics::FillRows(const QRectF& area, const QColor& color) {
    if (color.alpha() == 255 || !IsWhole(area.top()) || !IsWhole(area.height()) ||
        !KeepsWholePixels(painter_.deviceTransform())) {
        painter_.fillRect(area, color);
        return;
    }
    const double rows = RowsOnDevice(kBlendRows);
    for (double top = area.top(); top < area.bottom(); top += rows) {
        painter_.fillRect(
            QRectF(area.left(), top, area.width(), std::min(rows, area.bottom() - top)), color);
    }
}

// The rows of this surface that make `deviceRows` rows on the device, at least one: the limit
// is on device rows, so on a screen of two pixels a point it is half as many.
double Graphics::RowsOnDevice(double deviceRows) const {
    const double scale = std::abs(painter_.deviceTransform().m22());
    return scale > 0 ? std::max(1.0, std::floor(deviceRows / scale)) : deviceRows;
}

void Graphics::DrawLine(double x1, double y1, double x2, double y2) {
    const QColor color = ToQColor(ForeColor, Transparency);
    if (y1 == y2) {
        painter_.fillRect(QRectF(std::min(x1, x2), y1, std::abs(x2 - x1) + 1, PenHeight), color);
    } else if (x1 == x2) {
        painter_.fillRect(QRectF(x1, std::min(y1, y2), PenWidth, std::abs(y2 - y1) + 1), color);
    } else {
        painter_.save();
        painter_.setPen(QPen(color, std::max(PenWidth, PenHeight)));
        painter_.drawLine(QPointF(x1 + 0.5, y1 + 0.5), QPointF(x2 + 0.5, y2 + 0.5));
        painter_.restore();
    }
}

void Graphics::DrawString(const std::string& text, double x, double y, double wrapWidth,
                          bool /*condense*/) {
    QFont font = painter_.font();
    SetFontFamily(font, TextFont);
    if (TextSize > 0) {
        font.setPixelSize(static_cast<int>(std::lround(TextSize)));
    }
    font.setBold(Bold);
    painter_.save();
    painter_.setRenderHint(QPainter::TextAntialiasing, true);
    painter_.setFont(font);
    painter_.setPen(ToQColor(ForeColor, Transparency));
    const QString qtext = QString::fromStdString(text);
    if (wrapWidth > 0) {
        const double ascent = painter_.fontMetrics().ascent();
        painter_.drawText(QRectF(x, y - ascent, wrapWidth, height_), Qt::TextWordWrap, qtext);
    } else {
        painter_.drawText(QPointF(x, y), qtext);
    }
    painter_.restore();
}
