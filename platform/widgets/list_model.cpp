// ListModel: data() is a bounds check and a lookup in the store.
#include "platform/widgets/list_model.h"

#include <QSize>
#include <QTableView>
#include <QTimer>

#include "platform/widgets/shown_text.h"

ListModel::ListModel() : store_(1) {}

int ListModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : shown_;
}

int ListModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : Columns();
}

QVariant ListModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid() || index.row() >= shown_ || index.column() >= Columns()) {
        return {};
    }
    switch (role) {
        case Qt::DisplayRole: {
            const std::string_view text =
                store_.Field(static_cast<size_t>(index.row()), index.column());
            return ShownText(text, kShownInCell);
        }
        case Qt::SizeHintRole:
            return QSize(-1, rowHeight_);
        default:
            return {};
    }
}

QVariant ListModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation == Qt::Horizontal && role == Qt::DisplayRole) {
        return headings_.value(section);
    }
    return {};
}

void ListModel::sort(int column, Qt::SortOrder order) {
    sortColumn_ = column;
    sortOrder_ = order;
    Flush();
    ApplySort();
}

void ListModel::SetColumns(const QStringList& headings) {
    beginResetModel();
    headings_ = headings;
    // One field more than columns: the row's tag.
    store_.SetFieldCount(static_cast<int>(headings.size()) + 1);
    shown_ = 0;
    endResetModel();
}

void ListModel::Reset() {
    beginResetModel();
    store_.Clear();
    shown_ = 0;
    endResetModel();
}

void ListModel::RowAdded() {
    if (!flushPending_) {
        flushPending_ = true;
        QTimer::singleShot(0, this, [this] { Flush(); });
    }
}

void ListModel::CellChanged(size_t row, int column) {
    if (static_cast<int>(row) < shown_) {
        emit dataChanged(index(static_cast<int>(row), column),
                         index(static_cast<int>(row), column));
    }
}

void ListModel::Flush() {
    flushPending_ = false;
    const int count = static_cast<int>(store_.Count());
    if (count > shown_) {
        beginInsertRows({}, shown_, count - 1);
        shown_ = count;
        endInsertRows();
        if (sortColumn_ >= 0) {
            ApplySort();
        }
    }
}

// With a sort order chosen, the first screen waits for the sort: the rows come on screen once,
// sorted, when the load is over. Rows shown unsorted and then put in order would jump under
// the user's eyes, and sorting at every paint would cost a long load dearly.
bool ListModel::ShowRowsWhileLoading() {
    if (sortColumn_ >= 0 || static_cast<int>(store_.Count()) <= shown_) {
        return false;
    }
    Flush();
    return true;
}

void ShowRowsAddedSoFar(QTableView& view) {
    auto* model = dynamic_cast<ListModel*>(view.model());
    if (!model) {
        return;
    }
    // Once the viewport is full, rows below it would change nothing but the scroll bar, whose
    // update repaints the whole viewport, and each insertion costs the view time in proportion
    // to all its rows: the rest reach the view in one insertion when the load is over.
    const int shown = model->rowCount();
    if (shown > 0 && view.rowViewportPosition(shown - 1) + view.rowHeight(shown - 1) >=
                         view.viewport()->height()) {
        return;
    }
    if (model->ShowRowsWhileLoading()) {
        view.doItemsLayout();
    }
}

// Persistent indexes, the selection among them, follow their rows to the new places.
void ListModel::ApplySort() {
    if (sortColumn_ < 0 || sortColumn_ >= Columns()) {
        return;
    }
    emit layoutAboutToBeChanged({}, QAbstractItemModel::VerticalSortHint);
    const auto order = store_.SortBy(sortColumn_, sortOrder_ == Qt::DescendingOrder);
    std::vector<int> newRowOf(order.size());
    for (size_t i = 0; i < order.size(); ++i) {
        newRowOf[order[i]] = static_cast<int>(i);
    }
    const QModelIndexList before = persistentIndexList();
    QModelIndexList after;
    for (const QModelIndex& old : before) {
        after.append(index(newRowOf[static_cast<size_t>(old.row())], old.column()));
    }
    changePersistentIndexList(before, after);
    emit layoutChanged({}, QAbstractItemModel::VerticalSortHint);
}
