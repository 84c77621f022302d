// Graphics over QPainter, with the inward outline rule worked out in filled shapes.
#include "platform/widgets/graphics.h"

#include <QFont>
#include <QPainter>
#include <QPainterPath>

#include <algorithm>
#include <cmath>

#include "platform/runtime/qt_color.h"
#include "platform/widgets/qt_font.h"

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
    painter_.fillRect(QRectF(x, y + ph, pw, height - 2 * ph), color);
    painter_.fillRect(QRectF(x + width - pw, y + ph, pw, height - 2 * ph), color);
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
    painter_.save();
    painter_.setRenderHint(QPainter::Antialiasing, true);
    painter_.fillPath(ring, ToQColor(ForeColor, Transparency));
    painter_.restore();
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
