// The widget of a TextArea: a plain text edit that rings itself while it has the focus.
#pragma once

#include <QPlainTextEdit>

class TextPane : public QPlainTextEdit {
  public:
    TextPane();

  protected:
    void paintEvent(QPaintEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
};
