// The text pane over QAbstractScrollArea. Qt's own text widgets lay a whole paragraph out at
// once: a 20 MB line takes them minutes and a million lines many seconds, so this pane finds
// its rows itself, on a fixed count of characters a row as a monospaced face gives it.
// A read-only pane takes the focus by Tab or a click so that its text can be scrolled by the
// keyboard; the ring shows a person where the keys go. It lies inside the frame, in the text's
// colour, which reads on the pane's ground.
#include "platform/widgets/text_pane.h"

#include <QAccessible>
#include <QAccessibleWidget>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QGuiApplication>
#include <QMenu>
#include <QPainter>
#include <QScrollBar>

#include <algorithm>
#include <cctype>
#include <climits>
#include <cstring>

#include "platform/core/text.h"

namespace {

constexpr int kMargin = 4;  // around the text, as in Qt's text widgets
constexpr size_t kRowsPerCheckpoint = 64;
constexpr qreal kRingWidth = 2.0;

bool IsLineBreak(char c) {
    return c == '\r' || c == '\n';
}

// Behind the line break that starts at `at`.
size_t AfterBreak(const std::string& text, size_t at) {
    return at + (text[at] == '\r' && at + 1 < text.size() && text[at + 1] == '\n' ? 2 : 1);
}

bool IsWordByte(char c) {
    const auto u = static_cast<unsigned char>(c);
    return u >= 0x80 || std::isalnum(u) || c == '_';
}

// A screen reader meets a pane of text that it may read and not change, named by its owner.
class AccessiblePane : public QAccessibleWidget {
  public:
    explicit AccessiblePane(QWidget* pane) : QAccessibleWidget(pane, QAccessible::EditableText) {}
    QAccessible::State state() const override {
        QAccessible::State state = QAccessibleWidget::state();
        state.readOnly = true;
        state.multiLine = true;
        return state;
    }
};

QAccessibleInterface* PaneInterface(const QString&, QObject* object) {
    auto* pane = dynamic_cast<TextPane*>(object);
    return pane ? new AccessiblePane(pane) : nullptr;
}

}  // namespace

TextPane::TextPane() : text_(std::make_shared<const std::string>()), checkpoints_{0} {
    static const bool accessible = (QAccessible::installFactory(PaneInterface), true);
    (void)accessible;
    setFocusPolicy(Qt::StrongFocus);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    viewport()->setCursor(Qt::IBeamCursor);
    viewport()->setBackgroundRole(QPalette::Base);
}

void TextPane::SetText(std::shared_ptr<const std::string> text) {
    text_ = text ? std::move(text) : std::make_shared<const std::string>();
    checkpoints_ = {0};
    rowCount_ = 1;
    columns_ = 0;
    anchor_ = caret_ = 0;
    verticalScrollBar()->setValue(0);
    if (isVisible()) {
        Relayout();
    }
    viewport()->update();
}

// The line ends are mended in one pass over the bytes: ShownLines, which replaces in the QString
// twice, made Select All then Copy of a 20 MB block take 82 ms instead of 41.
QString TextPane::SelectedText() const {
    const char* at = text_->data() + std::min(anchor_, caret_);
    const char* const end = text_->data() + std::max(anchor_, caret_);
    std::string lines;
    lines.reserve(static_cast<size_t>(end - at));
    while (at < end) {
        const auto* cr =
            static_cast<const char*>(std::memchr(at, '\r', static_cast<size_t>(end - at)));
        lines.append(at, cr ? cr : end);
        if (!cr) {
            break;
        }
        lines += '\n';
        at = cr + 1 < end && cr[1] == '\n' ? cr + 2 : cr + 1;
    }
    return QString::fromUtf8(lines.data(), static_cast<qsizetype>(lines.size()));
}

void TextPane::SelectAll() {
    Select(0, text_->size());
}

void TextPane::Copy() const {
    if (HasSelection()) {
        QGuiApplication::clipboard()->setText(SelectedText());
    }
}

// Up to `columns_` characters, broken behind the last blank that fits if the line goes on.
TextPane::Row TextPane::RowFrom(size_t start) const {
    const std::string& text = *text_;
    const int columns = std::max(columns_, 1);  // at least one character, so that rows advance
    size_t at = start;
    for (int count = 0; at < text.size() && !IsLineBreak(text[at]); ++at) {
        if (!IsContinuation(text[at]) && count++ == columns) {
            break;
        }
    }
    if (at == text.size()) {
        return {start, at, at};
    }
    if (IsLineBreak(text[at])) {
        return {start, at, AfterBreak(text, at)};
    }
    if (text[at] == ' ') {
        // The blank hangs at the row's end, and so does a line break right behind it.
        const size_t end = at + 1;
        return {start, end,
                end < text.size() && IsLineBreak(text[end]) ? AfterBreak(text, end) : end};
    }
    for (size_t blank = at - 1; blank > start; --blank) {
        if (text[blank] == ' ') {
            return {start, blank + 1, blank + 1};
        }
    }
    return {start, at, at};
}

TextPane::Row TextPane::RowAt(size_t number) const {
    number = std::min(number, rowCount_ - 1);
    Row row = RowFrom(checkpoints_[number / kRowsPerCheckpoint]);
    for (size_t i = number % kRowsPerCheckpoint; i > 0 && !IsLast(row); --i) {
        row = RowFrom(row.next);
    }
    return row;
}

void TextPane::Relayout() {
    // Unhinted, a character's advance is a fraction of a pixel: rounded, a row would overflow.
    const qreal advance = QFontMetricsF(font()).horizontalAdvance(QLatin1Char('0'));
    const int columns =
        std::max(1, static_cast<int>((viewport()->width() - 2 * kMargin) / std::max(advance, 1.0)));
    if (columns != columns_) {
        columns_ = columns;
        checkpoints_.clear();
        rowCount_ = 0;
        for (size_t start = 0;; ++rowCount_) {
            if (rowCount_ % kRowsPerCheckpoint == 0) {
                checkpoints_.push_back(start);
            }
            const Row row = RowFrom(start);
            if (IsLast(row)) {
                ++rowCount_;
                break;
            }
            start = row.next;
        }
    }
    const size_t shown =
        static_cast<size_t>(std::max(1, (viewport()->height() - kMargin) / LineHeight()));
    QScrollBar& bar = *verticalScrollBar();
    bar.setRange(
        0, static_cast<int>(std::min<size_t>(rowCount_ - std::min(rowCount_, shown), INT_MAX)));
    bar.setPageStep(static_cast<int>(shown));
    bar.setSingleStep(1);
}

int TextPane::LineHeight() const {
    return std::max(1, fontMetrics().height());
}

QString TextPane::Decode(size_t from, size_t to) const {
    return QString::fromUtf8(text_->data() + from, static_cast<qsizetype>(to - from));
}

qreal TextPane::XOf(const Row& row, size_t offset) const {
    return kMargin + QFontMetricsF(font()).horizontalAdvance(Decode(row.start, offset));
}

// The character boundary of the row under the point that lies nearest to it.
size_t TextPane::OffsetAt(QPoint point) const {
    const int line = point.y() < 0 ? -1 : std::max(0, point.y() - kMargin) / LineHeight();
    const long long number =
        std::max(0LL, verticalScrollBar()->value() + static_cast<long long>(line));
    const Row row = RowAt(static_cast<size_t>(number));
    size_t before = row.start;
    qreal beforeX = kMargin;
    for (size_t at = row.start + 1; at <= row.end; ++at) {
        if (at < row.end && IsContinuation((*text_)[at])) {
            continue;
        }
        const qreal x = XOf(row, at);
        if (x >= point.x()) {
            return point.x() - beforeX <= x - point.x() ? before : at;
        }
        before = at;
        beforeX = x;
    }
    return row.end;
}

void TextPane::Select(size_t anchor, size_t caret) {
    anchor_ = anchor;
    caret_ = caret;
    viewport()->update();
}

void TextPane::paintEvent(QPaintEvent*) {
    QPainter painter(viewport());
    painter.setFont(font());
    const QFontMetrics metrics = fontMetrics();
    const int lineHeight = LineHeight();
    const size_t from = std::min(anchor_, caret_);
    const size_t to = std::max(anchor_, caret_);
    Row row = RowAt(static_cast<size_t>(verticalScrollBar()->value()));
    for (int y = kMargin; y < viewport()->height(); y += lineHeight) {
        const int baseline = y + metrics.ascent();
        painter.setPen(palette().color(QPalette::Text));
        painter.drawText(kMargin, baseline, Decode(row.start, row.end));
        // The selection within the row, to the right edge where it takes the line break too.
        const size_t low = std::max(from, row.start);
        const size_t high = std::min(to, IsLast(row) ? row.end : row.next);
        if (low < high) {
            const qreal left = XOf(row, low);
            const qreal right = high > row.end ? viewport()->width() : XOf(row, high);
            painter.fillRect(QRectF(left, y, right - left, lineHeight), palette().highlight());
            painter.setPen(palette().color(QPalette::HighlightedText));
            painter.drawText(QPointF(left, baseline), Decode(low, std::min(high, row.end)));
        }
        if (IsLast(row)) {
            break;
        }
        row = RowFrom(row.next);
    }
    if (hasFocus()) {
        painter.setPen(QPen(palette().color(QPalette::Text), kRingWidth));
        painter.setBrush(Qt::NoBrush);
        painter.drawRect(QRectF(viewport()->rect()).adjusted(1, 1, -1, -1));
    }
}

void TextPane::resizeEvent(QResizeEvent* event) {
    QAbstractScrollArea::resizeEvent(event);
    Relayout();
}

void TextPane::showEvent(QShowEvent* event) {
    QAbstractScrollArea::showEvent(event);
    Relayout();
}

void TextPane::changeEvent(QEvent* event) {
    QAbstractScrollArea::changeEvent(event);
    if (event->type() == QEvent::FontChange) {
        columns_ = 0;
        if (isVisible()) {
            Relayout();
        }
    }
}

void TextPane::focusInEvent(QFocusEvent* event) {
    QAbstractScrollArea::focusInEvent(event);
    viewport()->update();
}

void TextPane::focusOutEvent(QFocusEvent* event) {
    QAbstractScrollArea::focusOutEvent(event);
    viewport()->update();
}

void TextPane::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_Home || event->key() == Qt::Key_End) {
        verticalScrollBar()->triggerAction(event->key() == Qt::Key_Home
                                               ? QAbstractSlider::SliderToMinimum
                                               : QAbstractSlider::SliderToMaximum);
        return;
    }
    QAbstractScrollArea::keyPressEvent(event);
}

void TextPane::mousePressEvent(QMouseEvent* event) {
    if (event->button() != Qt::LeftButton) {
        return;
    }
    const size_t at = OffsetAt(event->position().toPoint());
    Select(event->modifiers().testFlag(Qt::ShiftModifier) ? anchor_ : at, at);
}

// A drag past the top or the bottom scrolls a row for each move of the mouse.
void TextPane::mouseMoveEvent(QMouseEvent* event) {
    if (!(event->buttons() & Qt::LeftButton)) {
        return;
    }
    const QPoint point = event->position().toPoint();
    QScrollBar& bar = *verticalScrollBar();
    if (point.y() < 0) {
        bar.setValue(bar.value() - 1);
    } else if (point.y() > viewport()->height()) {
        bar.setValue(bar.value() + 1);
    }
    Select(anchor_, OffsetAt(point));
}

void TextPane::mouseDoubleClickEvent(QMouseEvent* event) {
    if (event->button() != Qt::LeftButton) {
        return;
    }
    size_t from = OffsetAt(event->position().toPoint());
    size_t to = from;
    while (from > 0 && IsWordByte((*text_)[from - 1])) {
        --from;
    }
    while (to < text_->size() && IsWordByte((*text_)[to])) {
        ++to;
    }
    Select(from, to);
}

void TextPane::contextMenuEvent(QContextMenuEvent* event) {
    QMenu menu;
    QAction* copy = menu.addAction(QStringLiteral("&Copy"));
    copy->setEnabled(HasSelection());
    QAction* all = menu.addAction(QStringLiteral("Select All"));
    QAction* chosen = menu.exec(event->globalPos());
    if (chosen == copy) {
        Copy();
    } else if (chosen == all) {
        SelectAll();
    }
}
