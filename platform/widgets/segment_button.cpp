// A segment paints itself with the colours of the palette at each paint, so a change of the
// desktop's appearance shows at the next one, both ways; a style sheet would keep the colours
// it was given when it was first applied.
#include "platform/widgets/segment_button.h"

#include <QKeyEvent>
#include <QPainter>
#include <QPainterPath>

#include "platform/widgets/desktop_colors.h"

namespace {

constexpr qreal kRadius = 5.0;
// The focus ring lies inside the segment's border, on the segment's own ground, so that it
// shows against the ground whatever lies around the segment.
constexpr qreal kRingInset = 2.5;
constexpr qreal kRingWidth = 2.0;

// The segment's outline, rounded only at the ends of the row.
QPainterPath Outline(const QRectF& r, SegmentButton::Ends ends, qreal radius) {
    QPainterPath path;
    path.setFillRule(Qt::WindingFill);  // the square halves add to the rounded box
    path.addRoundedRect(r, radius, radius);
    if (!ends.left) {
        path.addRect(r.adjusted(0, 0, -r.width() / 2, 0));
    }
    if (!ends.right) {
        path.addRect(r.adjusted(r.width() / 2, 0, 0, 0));
    }
    return path.simplified();
}

}  // namespace

SegmentButton::SegmentButton(const QString& title, QWidget* parent, Ends ends,
                             std::function<void(int)> step)
    : QPushButton(title, parent), ends_(ends), step_(std::move(step)) {
    setCheckable(true);
    // Reached by Tab, as on macOS; a click leaves the focus where it was.
    setFocusPolicy(Qt::TabFocus);
}

// A segment takes the focus by Tab; the arrow keys choose its neighbour.
void SegmentButton::keyPressEvent(QKeyEvent* event) {
    switch (event->key()) {
        case Qt::Key_Left:
        case Qt::Key_Up:
            step_(-1);
            break;
        case Qt::Key_Right:
        case Qt::Key_Down:
            step_(1);
            break;
        default:
            QPushButton::keyPressEvent(event);
    }
}

// The chosen segment lies on the selection colour, the others on the button colour; the text
// and the focus ring take the colour that reads on that ground.
void SegmentButton::paintEvent(QPaintEvent*) {
    const QPalette& colours = palette();
    const QColor text =
        colours.color(isChecked() ? QPalette::HighlightedText : QPalette::ButtonText);
    QColor ground = isChecked() ? ReadableGround(colours.color(QPalette::Highlight), text)
                                : colours.color(QPalette::Button);
    if (isDown()) {
        ground = ground.darker(115);
    }
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF box = QRectF(rect()).adjusted(0.5, 0.5, -0.5, -0.5);
    painter.setPen(QPen(colours.color(QPalette::Mid), 1.0));
    painter.setBrush(ground);
    painter.drawPath(Outline(box, ends_, kRadius));
    if (hasFocus()) {
        const QRectF ring = box.adjusted(kRingInset, kRingInset, -kRingInset, -kRingInset);
        painter.setPen(QPen(text, kRingWidth));
        painter.setBrush(Qt::NoBrush);
        painter.drawPath(Outline(ring, ends_, kRadius - kRingInset / 2));
    }
    painter.setPen(text);
    painter.drawText(rect(), Qt::AlignCenter,
                     fontMetrics().elidedText(this->text(), Qt::ElideRight, width() - 8));
}
