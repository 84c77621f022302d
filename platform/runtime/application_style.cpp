// The application's style and its icon that is read when first drawn.
#include "platform/runtime/application_style.h"

#include <QApplication>
#include <QIconEngine>
#include <QPainter>
#include <QPointer>

namespace {

// Stands for a style's icon and reads it at its first use.
class DeferredIcon : public QIconEngine {
  public:
    DeferredIcon(ApplicationStyle* style, QStyle::StandardPixmap which)
        : style_(style), which_(which) {}

    void paint(QPainter* painter, const QRect& rect, QIcon::Mode mode,
               QIcon::State state) override {
        Icon().paint(painter, rect, Qt::AlignCenter, mode, state);
    }
    QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State state) override {
        return Icon().pixmap(size, mode, state);
    }
    QSize actualSize(const QSize& size, QIcon::Mode mode, QIcon::State state) override {
        return Icon().actualSize(size, mode, state);
    }
    QList<QSize> availableSizes(QIcon::Mode mode, QIcon::State state) override {
        return Icon().availableSizes(mode, state);
    }
    QIconEngine* clone() const override { return new DeferredIcon(style_, which_); }

  private:
    // The desktop style's icon; a style that has gone since is asked through the application.
    const QIcon& Icon() {
        if (!read_) {
            icon_ = style_ ? style_->QProxyStyle::standardIcon(which_)
                           : QApplication::style()->standardIcon(which_);
            read_ = true;
        }
        return icon_;
    }

    QPointer<ApplicationStyle> style_;
    QStyle::StandardPixmap which_;
    QIcon icon_;
    bool read_ = false;
};

}  // namespace

QIcon ApplicationStyle::standardIcon(StandardPixmap standardIcon, const QStyleOption* option,
                                     const QWidget* widget) const {
    if (standardIcon == SP_ToolBarHorizontalExtensionButton) {
        return QIcon(new DeferredIcon(const_cast<ApplicationStyle*>(this), standardIcon));
    }
    return QProxyStyle::standardIcon(standardIcon, option, widget);
}
