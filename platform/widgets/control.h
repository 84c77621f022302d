// Control: what every control of a window has: name and index, window coordinates, page,
// font and the widget that shows it.
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "platform/core/property_block.h"
#include "platform/core/ref.h"

class Control;
class QObject;
class QWidget;

// What a control asks of the window that holds it.
class ControlHost {
  public:
    virtual QWidget* Client() const = 0;
    virtual void UpdateVisibility() = 0;
    // Nil when there is no such control.
    virtual const Ref<Control>& _ControlByName(std::string_view name) const = 0;

  protected:
    ~ControlHost() = default;
};

class Control : public PropertyObject, public std::enable_shared_from_this<Control> {
  public:
    static constexpr long long kNoIndex = -2147483648LL;

    Control();
    ~Control() override;

    void SetProperty(const std::string& name, const PropertyValue& value) override;
    void PropertiesApplied() override;

    const std::string& Name() const { return name_; }
    long long Index() const { return index_; }
    void SetIndex(long long index) { index_ = index; }
    int Left() const { return left_; }
    int Top() const { return top_; }
    int Width() const { return width_; }
    int Height() const { return height_; }
    long long TabPanelIndex() const { return tabPanelIndex_; }

    // What a screen reader calls the control, where the widget has no text of its own to offer.
    void SetAccessibleName(const std::string& name);

    // The control that this one stands in, by its initial parent; Nil for the window itself.
    Ref<Control> Parent() const;
    // Whether the control can be seen: visible itself, on the page its container shows.
    bool IsShown() const;
    // Containers whose pages hide and show the controls that lie on them.
    virtual bool IsPageContainer() const { return false; }
    virtual bool ShowsPage(long long /*tabPanelIndex*/) const { return true; }

    // Raised once when the window has built all its controls.
    virtual void RaiseOpen() {}
    // Return or Enter that no control took: a shown default button presses itself and says so.
    virtual bool PressAsDefault() { return false; }

    // Platform use: the widget, null once the window that showed it is gone, and the
    // window's hand-over when the control is entered.
    QWidget* Widget() const { return widget_; }
    // The context of the control's signal connections: they end when the control does.
    QObject* Context() const { return context_.get(); }
    void AttachTo(const std::shared_ptr<ControlHost>& window);
    virtual void DetachWidget() { widget_ = nullptr; }

  protected:
    // The window that holds the control; null before it is entered and once the window goes.
    std::shared_ptr<ControlHost> Host() const { return window_.lock(); }
    // Takes ownership of the widget until the window adopts it.
    void SetWidget(QWidget* widget);
    // The widget, or NilObjectException once the window that showed it is gone.
    QWidget& LiveWidget() const;
    void Place();

  private:
    std::string name_;
    long long index_ = kNoIndex;
    int left_ = 0, top_ = 0, width_ = 0, height_ = 0;
    long long tabPanelIndex_ = 0;
    bool visible_ = true;
    std::string initialParent_;
    std::weak_ptr<ControlHost> window_;
    QWidget* widget_ = nullptr;
    bool widgetAdopted_ = false;
    std::unique_ptr<QObject> context_;

    void SetWidgetFont();
    void ApplyCommon(const std::string& name, const PropertyValue& value);
};
