// ListModel: the Qt model over a list's RowStore. Rows added by a handler reach the view in
// one insertion once the event loop is free again; a full reload is one model reset.
#pragma once

#include <QAbstractTableModel>
#include <QStringList>

#include "platform/core/row_store.h"

class QTableView;

class ListModel : public QAbstractTableModel {
  public:
    ListModel();

    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    void sort(int column, Qt::SortOrder order) override;

    RowStore& Store() { return store_; }
    const RowStore& Store() const { return store_; }
    void SetColumns(const QStringList& headings);
    int Columns() const { return static_cast<int>(headings_.size()); }
    void SetRowHeight(int height) { rowHeight_ = height; }
    int RowHeight() const { return rowHeight_; }
    int SortColumn() const { return sortColumn_; }
    Qt::SortOrder SortOrder() const { return sortOrder_; }

    void Reset();
    void RowAdded();
    void CellChanged(size_t row, int column);
    // Shows the rows added so far, sorted if a sort order was chosen.
    void Flush();
    // The cooperative yield's part: shows the rows added so far if no sort order was chosen.
    // True if the view got rows.
    bool ShowRowsWhileLoading();

  private:
    void ApplySort();

    RowStore store_;
    QStringList headings_;
    int rowHeight_ = 25;
    int shown_ = 0;  // rows that the view knows of
    bool flushPending_ = false;
    int sortColumn_ = -1;
    Qt::SortOrder sortOrder_ = Qt::AscendingOrder;
};

// Lets a view over a ListModel show the rows added so far, from inside the cooperative yield,
// where its timers don't run: it is laid out at once.
void ShowRowsAddedSoFar(QTableView& view);
