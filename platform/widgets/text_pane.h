// TextPane: a read-only view of a text of any length, wrapped to its width at blanks or, in a
// long word, anywhere. It paints only the rows on screen and keeps the start of every 64th row
// alone, so that a text of many megabytes, on one line or on millions, repaints as fast as a
// short one and costs little beside the text itself. The mouse selects; Copy and Select All
// act on the whole text. It rings itself while it has the focus, and a screen reader reads it
// as a read-only text.
#pragma once

#include <QAbstractScrollArea>

#include <memory>
#include <string>
#include <vector>

class TextPane : public QAbstractScrollArea {
  public:
    TextPane();
    // UTF-8 whose lines end in CR, LF or CR LF; shared with its owner, not copied. The
    // selection goes and the view returns to the top.
    void SetText(std::shared_ptr<const std::string> text);
    bool HasSelection() const { return anchor_ != caret_; }
    // The selection, its lines ended by LF as the clipboard expects.
    QString SelectedText() const;
    void SelectAll();
    void Copy() const;

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void changeEvent(QEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;

  private:
    // A row of the screen: its text is [start, end); the next row starts at `next`, behind
    // the line break or the blank where it wrapped. The last row ends at the end of the text.
    struct Row {
        size_t start, end, next;
    };
    Row RowFrom(size_t start) const;
    Row RowAt(size_t number) const;
    bool IsLast(const Row& row) const { return row.end == text_->size(); }
    // Wraps the text again if the width in characters changed, and sets the scroll bar.
    void Relayout();
    int LineHeight() const;
    QString Decode(size_t from, size_t to) const;
    qreal XOf(const Row& row, size_t offset) const;
    size_t OffsetAt(QPoint point) const;
    void Select(size_t anchor, size_t caret);

    std::shared_ptr<const std::string> text_;
    std::vector<size_t> checkpoints_;  // the start of rows 0, 64, 128 and so on
    size_t rowCount_ = 1;
    int columns_ = 0;  // characters a row holds; 0 until the text is wrapped
    size_t anchor_ = 0, caret_ = 0;
};
