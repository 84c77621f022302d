// ListView: Return opens the selected row, Home and End go to the first and last row, typing
// finds a row by the sort column, Tab leaves the list, Copy takes the row with its heading,
// a cell that is cut shows its whole text in a tooltip, and the focused list rings its current
// row.
#include "platform/widgets/list_view.h"

#include <QApplication>
#include <QClipboard>
#include <QHeaderView>
#include <QHelpEvent>
#include <QKeyEvent>
#include <QPainter>
#include <QStyleOptionHeader>
#include <QToolTip>

#include <algorithm>
#include <numeric>

#include "platform/widgets/list_model.h"

namespace {

constexpr qreal kRingWidth = 2.0;

// A row on the clipboard is one line of fields: tabs and line breaks inside a cell become
// blanks.
QString OneLine(QString text) {
    for (QChar& c : text) {
        if (c == '\t' || c == '\r' || c == '\n') {
            c = ' ';
        }
    }
    return text;
}

// Qt measures header sections in the bold form of the header's font, which loads a second
// font at start for nothing: the sections take the widths that the list gives them, and a
// font's bold form is as high as the font. So the header's own font measures them.
class ListHeader : public QHeaderView {
  public:
    explicit ListHeader(QWidget* parent) : QHeaderView(Qt::Horizontal, parent) {}

  protected:
    QSize sectionSizeFromContents(int logicalIndex) const override {
        QStyleOptionHeader option;
        initStyleOption(&option);
        option.section = logicalIndex;
        option.fontMetrics = fontMetrics();
        option.text = model()->headerData(logicalIndex, orientation()).toString();
        if (isSortIndicatorShown()) {
            option.sortIndicator = QStyleOptionHeader::SortDown;
        }
        return style()->sizeFromContents(QStyle::CT_HeaderSection, &option, QSize(), this);
    }
};

}  // namespace

ListView::ListView() : showDuringLoad_([this] { ShowRowsAddedSoFar(*this); }) {
    setHorizontalHeader(new ListHeader(this));
    setTabKeyNavigation(false);
}

void ListView::SetDesignedWidths(std::vector<int> widths) {
    designedWidths_ = std::move(widths);
    FitColumns();
}

void ListView::CopySelection() const {
    const QModelIndexList rows =
        HasSelectedRow() ? selectionModel()->selectedRows() : QModelIndexList();
    if (!model() || rows.isEmpty()) {
        return;
    }
    QStringList headings;
    QStringList cells;
    for (int column = 0; column < model()->columnCount(); ++column) {
        headings << OneLine(model()->headerData(column, Qt::Horizontal).toString());
        cells << OneLine(model()->index(rows.first().row(), column).data().toString());
    }
    QApplication::clipboard()->setText(headings.join('\t') + '\n' + cells.join('\t') + '\n');
}

void ListView::keyPressEvent(QKeyEvent* event) {
    const bool open = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    if (open && HasSelectedRow()) {
        event->accept();
        if (OpenRequested) {
            OpenRequested();
        }
        return;
    }
    // The list that gets the focus makes its first row current, and rings it, without choosing
    // it: the first arrow key chooses that row rather than its neighbour.
    const bool arrow = event->key() == Qt::Key_Down || event->key() == Qt::Key_Up;
    if (arrow && event->modifiers() == Qt::NoModifier && !HasSelectedRow() &&
        currentIndex().isValid()) {
        event->accept();
        setCurrentIndex(currentIndex());
        return;
    }
    if (event->matches(QKeySequence::Copy)) {
        // Qt's own copy would take the current cell alone.
        event->accept();
        CopySelection();
        return;
    }
    QTableView::keyPressEvent(event);
}

// The current row's ring, in the colour of the row's text, which reads on the row's ground.
void ListView::paintEvent(QPaintEvent* event) {
    QTableView::paintEvent(event);
    const QModelIndex current = currentIndex();
    if (!hasFocus() || !current.isValid() || !model()) {
        return;
    }
    const QRect row = visualRect(current.siblingAtColumn(0))
                          .united(visualRect(current.siblingAtColumn(model()->columnCount() - 1)));
    const bool selected = selectionModel()->isRowSelected(current.row(), current.parent());
    QPainter painter(viewport());
    painter.setPen(
        QPen(palette().color(selected ? QPalette::HighlightedText : QPalette::Text), kRingWidth));
    painter.drawRect(QRectF(row).adjusted(1.5, 1.5, -1.5, -1.5));
}

// Home and End go to the first and last row, not to the ends of the row: the list never
// scrolls sideways.
QModelIndex ListView::moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) {
    if ((action == MoveHome || action == MoveEnd) && model()) {
        const int rows = model()->rowCount();
        const int column = currentIndex().isValid() ? currentIndex().column() : 0;
        return rows == 0 ? QModelIndex()
                         : model()->index(action == MoveHome ? 0 : rows - 1, column);
    }
    return QTableView::moveCursor(action, modifiers);
}

// Letters typed in quick succession make one prefix; the same letter again steps on to the
// next row that begins with it.
void ListView::keyboardSearch(const QString& search) {
    if (!model() || search.isEmpty()) {
        return;
    }
    const bool goesOn =
        searchClock_.isValid() && searchClock_.elapsed() < QApplication::keyboardInputInterval();
    search_ = goesOn ? search_ + search : search;
    searchClock_.start();
    const bool oneLetter = search_.count(search_.front()) == search_.size();
    const QString prefix = oneLetter ? search_.left(1) : search_;

    const int rows = model()->rowCount();
    const int current = currentIndex().isValid() ? currentIndex().row() : -1;
    const int first = oneLetter ? current + 1 : std::max(current, 0);
    // The column that the list is sorted by, or the first.
    const QHeaderView* header = horizontalHeader();
    const int column =
        header->isSortIndicatorShown() ? std::max(header->sortIndicatorSection(), 0) : 0;
    for (int i = 0; i < rows; ++i) {
        const QModelIndex index = model()->index((first + i) % rows, column);
        if (index.data().toString().startsWith(prefix, Qt::CaseInsensitive)) {
            setCurrentIndex(index);
            return;
        }
    }
}

// Also raised when the vertical scrollbar comes or goes, since that resizes the viewport.
void ListView::resizeEvent(QResizeEvent* event) {
    QTableView::resizeEvent(event);
    FitColumns();
}

// The cell under the pointer shows its whole text as a tooltip when it is too narrow for it.
bool ListView::viewportEvent(QEvent* event) {
    if (event->type() != QEvent::ToolTip) {
        return QTableView::viewportEvent(event);
    }
    const auto* help = static_cast<QHelpEvent*>(event);
    const QModelIndex index = indexAt(help->pos());
    const QString text = index.data().toString();
    const QRect cell = visualRect(index);
    const int margin = style()->pixelMetric(QStyle::PM_FocusFrameHMargin, nullptr, this) + 1;
    if (index.isValid() && fontMetrics().horizontalAdvance(text) + 2 * margin > cell.width()) {
        QToolTip::showText(help->globalPos(), text, viewport(), cell);
    } else {
        QToolTip::hideText();
        event->ignore();
    }
    return true;
}

// The columns share the inside of the list in the designed proportions; the scrollbar, when
// it shows, and the pixels lost to rounding come out of the widest column.
void ListView::FitColumns() {
    const int designed = std::accumulate(designedWidths_.begin(), designedWidths_.end(), 0);
    if (designed <= 0) {
        return;
    }
    const int inside = width() - 2 * frameWidth();
    std::vector<int> widths;
    for (const int width : designedWidths_) {
        widths.push_back(std::max(width, 0) * inside / designed);
    }
    const auto widest =
        std::max_element(designedWidths_.begin(), designedWidths_.end()) - designedWidths_.begin();
    widths[widest] += viewport()->width() - std::accumulate(widths.begin(), widths.end(), 0);
    for (size_t i = 0; i < widths.size(); ++i) {
        setColumnWidth(static_cast<int>(i), std::max(widths[i], 0));
    }
}
