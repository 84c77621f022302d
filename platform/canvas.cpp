// Canvas over a transparent QWidget whose paint raises the control's Paint event.
#include "platform/canvas.h"

#include <QPaintEvent>
#include <QPainter>
#include <QWidget>

#include "platform/application.h"
#include "platform/qt_color.h"

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
        QPainter painter(this);
        auto g = New<Graphics>(painter, width(), height(),
                               FromQColor(palette().color(QPalette::Window)));
        std::vector<Rect> areas;
        for (const QRect& r : event->region()) {
            areas.push_back({r.left(), r.top(), r.width(), r.height()});
        }
        owner_->RaisePaint(g, areas);
    }

  private:
    Canvas* owner_;
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

void Canvas::RaisePaint(Ref<Graphics> g, const std::vector<Rect>& areas) {
    RaiseEvent([&] { Event_Paint(g, areas); });
}
