// The widgets of a SegmentedControl: the row, and its segments, buttons that stay chosen, drawn
// from the palette that the desktop has when they paint. A screen reader hears the row as a
// list of page tabs, one of them selected.
#pragma once

#include <QPushButton>

#include <functional>

class SegmentRow : public QWidget {
  public:
    SegmentRow();
};

class SegmentButton : public QPushButton {
  public:
    // Which ends of the row the segment stands at: those corners are rounded.
    struct Ends {
        bool left = false;
        bool right = false;
    };

    // `step` gets -1 or 1 when an arrow key asks for the neighbouring segment.
    SegmentButton(const QString& title, QWidget* parent, Ends ends, std::function<void(int)> step);

  protected:
    void keyPressEvent(QKeyEvent* event) override;
    void paintEvent(QPaintEvent* event) override;

  private:
    Ends ends_;
    std::function<void(int)> step_;
};
