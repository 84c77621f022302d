// The Qt top-level widget behind a Window, which tells its owner when the user closes it, and
// the client area that holds the controls and leads Tab through them in the window's order.
#pragma once

#include <QMainWindow>

#include <memory>

class Window;

class ClientArea : public QWidget {
  public:
    explicit ClientArea(std::weak_ptr<Window> owner) : owner_(std::move(owner)) {}

  protected:
    bool focusNextPrevChild(bool next) override;

  private:
    std::weak_ptr<Window> owner_;
};

class NativeWindow : public QMainWindow {
  public:
    explicit NativeWindow(std::weak_ptr<Window> owner) : owner_(std::move(owner)) {}

  protected:
    void closeEvent(QCloseEvent* event) override;
    // Return or Enter that the focused control left alone reaches the window's default button,
    // wherever the focus is; an open popup keeps its keys, since they never reach here.
    void keyPressEvent(QKeyEvent* event) override;

  private:
    std::weak_ptr<Window> owner_;
};
