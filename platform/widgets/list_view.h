// ListView: the table view behind a Listbox, with the keyboard, clipboard and column habits
// of a native desktop list.
#pragma once

#include <QElapsedTimer>
#include <QItemSelectionModel>
#include <QTableView>

#include <functional>
#include <vector>

#include "platform/runtime/yield.h"

class ListView : public QTableView {
  public:
    ListView();

    // Return or Enter on the selected row: what a double click on it does.
    std::function<void()> OpenRequested;

    // The designed widths; the columns keep their proportions and always fit the list.
    void SetDesignedWidths(std::vector<int> widths);
    bool HasSelectedRow() const { return selectionModel() && selectionModel()->hasSelection(); }
    // Puts the heading line and the selected row on the clipboard, tab-separated, each line
    // ending in a newline; without a selection it leaves the clipboard alone.
    void CopySelection() const;

  protected:
    void keyPressEvent(QKeyEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    QModelIndex moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) override;
    void keyboardSearch(const QString& search) override;
    void resizeEvent(QResizeEvent* event) override;
    bool viewportEvent(QEvent* event) override;

  private:
    void FitColumns();

    std::vector<int> designedWidths_;
    QString search_;
    QElapsedTimer searchClock_;
    // What the list shows of a load while the handler that loads it is still running.
    YieldHook showDuringLoad_;
};
