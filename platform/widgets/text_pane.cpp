// A read-only pane takes the focus by Tab or a click so that its text can be scrolled by the
// keyboard; the ring shows a person where the keys go. It lies inside the frame, in the text's
// colour, which reads on the pane's ground.
#include "platform/widgets/text_pane.h"

#include <QPainter>

namespace {
constexpr qreal kRingWidth = 2.0;
}

TextPane::TextPane() {
    setLineWrapMode(QPlainTextEdit::WidgetWidth);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
}

void TextPane::paintEvent(QPaintEvent* event) {
    QPlainTextEdit::paintEvent(event);
    if (!hasFocus()) {
        return;
    }
    QPainter painter(viewport());
    painter.setPen(QPen(palette().color(QPalette::Text), kRingWidth));
    painter.drawRect(QRectF(viewport()->rect()).adjusted(1, 1, -1, -1));
}

void TextPane::focusInEvent(QFocusEvent* event) {
    QPlainTextEdit::focusInEvent(event);
    viewport()->update();
}

void TextPane::focusOutEvent(QFocusEvent* event) {
    QPlainTextEdit::focusOutEvent(event);
    viewport()->update();
}
