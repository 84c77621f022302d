// The Qt top-level widget behind a Window; it tells its owner when the user closes it.
#pragma once

#include <QMainWindow>

#include <memory>

class Window;

class NativeWindow : public QMainWindow {
  public:
    explicit NativeWindow(std::weak_ptr<Window> owner) : owner_(std::move(owner)) {}

  protected:
    void closeEvent(QCloseEvent* event) override;

  private:
    std::weak_ptr<Window> owner_;
};
