// One segment of a SegmentedControl: a button that stays chosen, drawn from the palette that
// the desktop has when it paints.
#pragma once

#include <QPushButton>

#include <functional>

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
