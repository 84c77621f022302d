// Window1: its own properties, the accessor of the implicit instance and the navigation
// between the three pages.
#include "shell/window1.h"

#include "drawing/rect_box.h"
#include "platform/core/property_block.h"
#include "shell/main_menu_bar.h"

namespace {

std::string WindowProperties() {
    PropertyBlock block;
    block.Add("Title", std::string("Orbelane Verification Storage"))
        .Add("Width", 968LL)
        .Add("Height", 628LL)
        .Add("MinWidth", 64LL)
        .Add("MinHeight", 64LL)
        .Add("MaxWidth", 32000LL)
        .Add("MaxHeight", 32000LL)
        .Add("Frame", 9LL)
        .Add("CloseButton", true)
        .Add("Resizeable", false)
        .Add("MaximizeButton", false)
        .Add("MinimizeButton", false)
        .Add("FullScreenButton", false)
        .Add("Composite", false)
        .Add("MacProcID", 0LL)
        .Add("Placement", 0LL)
        .Add("Visible", true)
        .Add("LiveResize", true)
        .Add("FullScreen", false)
        .Add("HasBackColor", true)
        .Add("BackColor", ColorWord{0xFFFFFF})
        .Add("MenuBarVisible", true);
    return block.Bytes();
}

}  // namespace

void Window1::Layout() {
    SetMenuBar(MainMenuBar());
    _SetProperties(*this, WindowProperties());
}

Ref<RectBox> Window1::Canvas3() const {
    return ControlAs<RectBox>("Canvas3");
}
Ref<RectBox> Window1::Canvas2() const {
    return ControlAs<RectBox>("Canvas2");
}
Ref<RectBox> Window1::Canvas1() const {
    return ControlAs<RectBox>("Canvas1");
}

// The platform has already moved the selection when Action comes.
void Window1::MainTabs_Action(SegmentedControl&, long long segmentIndex) {
    if (segmentIndex == 0) {
        PagePanel1()->SetValue(0);
    } else if (segmentIndex == 1) {
        PagePanel1()->SetValue(1);
    }
}

// "Close" closes the report, not the window.
void Window1::PushButton2_Action(PushButton&) {
    PagePanel1()->SetValue(1);
}

Ref<class Window1> Window1() {
    Ref<class Window1> window = Cast<class Window1>(_GetImplicitWindow("Window1.Window1"));
    if (window.IsNil()) {
        window = NewWindow<class Window1>();
    }
    return window;
}
