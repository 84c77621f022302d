// Canvas over a transparent QWidget whose paint raises the control's Paint event.
#include "platform/widgets/canvas.h"

#include <QPaintEvent>
#include <QPainter>
#include <QTimer>
#include <QWidget>

#include "platform/runtime/application.h"
#include "platform/runtime/qt_color.h"
#include "platform/runtime/yield.h"

namespace {
class CanvasWidget : public QWidget {
  public:
    explicit CanvasWidget(Canvas& owner) : owner_(&owner) {}
    void Forget() { owner_ = nullptr; }

  protected:
    void paintEvent(QPaintEvent* event) override {
        if (!owner_) {
            return;
        }
        if (YieldIsPainting()) {
            PaintLater();
            return;
        }
        QPainter painter(this);
        auto g = New<Graphics>(painter, width(), height(),
                               FromQColor(palette().color(QPalette::Window)));
        std::vector<Rect> areas;
        for (const QRect& r : event->region()) {
            areas.push_back({r.left(), r.top(), r.width(), r.height()});
        }
        RaiseEvent([&, owner = owner_] { owner->Event_Paint(g, areas); });
    }

  private:
    // The Paint event runs the application's code, which must not run inside a handler that
    // gave way: the area shows the ground beneath until the event loop is free again.
    void PaintLater() {
        if (!paintPending_) {
            paintPending_ = true;
            QTimer::singleShot(0, this, [this] {
                paintPending_ = false;
                update();
            });
        }
    }

    Canvas* owner_;
    bool paintPending_ = false;
};
}  // namespace

Canvas::Canvas() {
    SetWidget(new CanvasWidget(*this));
}

void Canvas::DetachWidget() {
    if (auto* widget = static_cast<CanvasWidget*>(Widget())) {
        widget->Forget();
    }
    Control::DetachWidget();
}

void Canvas::Event_Paint(Ref<Graphics>, const std::vector<Rect>&) {}
