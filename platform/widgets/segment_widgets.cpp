// A segment paints itself with the colours of the palette at each paint, so a change of the
// desktop's appearance shows at the next one, both ways; a style sheet would keep the colours
// it was given when it was first applied. A segment chooses a page, as a tab does, so it is
// told to a screen reader as a page tab, selected or not, rather than as the check box that a
// button which stays down would be.
#include "platform/widgets/segment_widgets.h"

#include <QAccessible>
#include <QAccessibleWidget>
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

class SegmentAccessible : public QAccessibleWidget {
  public:
    explicit SegmentAccessible(SegmentButton* segment)
        : QAccessibleWidget(segment, QAccessible::PageTab) {}

    QString text(QAccessible::Text t) const override {
        return t == QAccessible::Name ? Segment().text() : QAccessibleWidget::text(t);
    }
    QAccessible::State state() const override {
        QAccessible::State state = QAccessibleWidget::state();
        state.selectable = true;
        state.selected = Segment().isChecked();
        return state;
    }
    QStringList actionNames() const override {
        return QStringList{pressAction()} + QAccessibleWidget::actionNames();
    }
    void doAction(const QString& name) override {
        if (name == pressAction()) {
            Segment().click();
        } else {
            QAccessibleWidget::doAction(name);
        }
    }

  private:
    QAbstractButton& Segment() const { return *static_cast<QAbstractButton*>(widget()); }
};

QAccessibleInterface* SegmentInterface(const QString&, QObject* object) {
    if (auto* segment = dynamic_cast<SegmentButton*>(object)) {
        return new SegmentAccessible(segment);
    }
    if (auto* row = dynamic_cast<SegmentRow*>(object)) {
        return new QAccessibleWidget(row, QAccessible::PageTabList);
    }
    return nullptr;
}

}  // namespace

SegmentRow::SegmentRow() {
    [[maybe_unused]] static const bool installed =
        (QAccessible::installFactory(SegmentInterface), true);
}

SegmentButton::SegmentButton(const QString& title, QWidget* parent, Ends ends,
                             std::function<void(int)> step)
    : QPushButton(parent), ends_(ends), step_(std::move(step)) {
    // Qt asks for the accessibility of a button as its title and kind are set, and keeps the
    // answer: set here, they find the object a segment already.
    setText(title);
    setCheckable(true);
    // Reached by Tab, as on macOS; a click leaves the focus where it was.
    setFocusPolicy(Qt::TabFocus);
    connect(this, &QAbstractButton::toggled, this, [this] {
        QAccessible::State changed;
        changed.selected = true;
        QAccessibleStateChangeEvent event(this, changed);
        QAccessible::updateAccessibility(&event);
    });
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
