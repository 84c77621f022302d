// Window: a top-level window of fixed size with its controls, found by name and index.
#pragma once

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "platform/core/color.h"
#include "platform/core/property_block.h"
#include "platform/core/ref.h"
#include "platform/widgets/control.h"

class MenuBar;
class NativeWindow;
class QWidget;

class Window : public PropertyObject,
               public ControlHost,
               public std::enable_shared_from_this<Window> {
  public:
    explicit Window(std::string className);
    ~Window() override;
    Window(const Window&) = delete;
    Window& operator=(const Window&) = delete;

    // Builds the window: Layout, CreateControls, the controls' Open events, the window's
    // Open event; then it shows, if Visible, and counts as open.
    void Constructor();
    virtual void Layout() {}
    virtual void CreateControls() {}
    virtual void Event_Open() {}

    void SetProperty(const std::string& name, const PropertyValue& value) override;

    const std::string& ClassName() const { return className_; }
    std::string Title() const { return PropertyOr<std::string>("Title"); }
    Color BackColor() const { return backColor_; }
    void SetBackColor(Color color);
    Ref<::MenuBar> MenuBar() const { return menuBar_; }
    void SetMenuBar(Ref<::MenuBar> menuBar);

    // Enters the control under its name; its index, if any, it brings along.
    void _AddControl(const Ref<Control>& control, const std::string& name);
    // Nil when there is no such control.
    const Ref<Control>& _ControlByName(std::string_view name) const override;
    Ref<Control> _ControlByNameIndex(const std::string& name, long long index) const;
    const std::vector<Ref<Control>>& Controls() const { return controls_; }
    // A control by name, cast to its class as the window's accessors give it.
    template <class T>
    Ref<T> ControlAs(std::string_view name) const {
        return Cast<T>(_ControlByName(name));
    }
    template <class T>
    Ref<T> ControlAs(const std::string& name, long long index) const {
        return Cast<T>(_ControlByNameIndex(name, index));
    }

    void Close();
    bool IsOpen() const { return open_; }

    // Platform use.
    QWidget* Client() const override { return client_; }
    QWidget* Native() const;
    void UpdateVisibility() override;
    void NativeClosed();

  private:
    std::string className_;
    NativeWindow* native_ = nullptr;
    QWidget* client_ = nullptr;
    std::vector<Ref<Control>> controls_;
    Ref<::MenuBar> menuBar_;
    Color backColor_ = 0xFFFFFF;
    bool open_ = false;
    bool built_ = false;
};

// Releases every open window; the run-time does so before the Qt application goes.
void ReleaseAllWindows();

// The live window of the class of that name, or Nil once it has closed.
Ref<Window> _GetImplicitWindow(const std::string& className);

// The accessor's allocation: a new window object, built by its constructor.
template <class T>
Ref<T> NewWindow() {
    auto window = std::make_shared<T>();
    window->Constructor();
    return Ref<T>(window);
}
