// Window over QMainWindow: fixed client size, title, close button only, background colour,
// menu bar; the registry of open windows for the implicit instance.
#include "platform/widgets/window.h"

#include <QCloseEvent>
#include <QKeyEvent>
#include <QLayout>
#include <QMenuBar>
#include <QWidget>

#include <algorithm>

#include "platform/runtime/application.h"
#include "platform/runtime/main_thread.h"
#include "platform/runtime/qt_color.h"
#include "platform/runtime/runtime.h"
#include "platform/widgets/accessible_names.h"
#include "platform/widgets/focus_order.h"
#include "platform/widgets/menu.h"
#include "platform/widgets/native_window.h"

namespace {
std::vector<std::shared_ptr<Window>> openWindows;

// Whether the control lies on a page of a container, or a tab: it comes and goes with it.
bool LiesOnPage(const Control& control) {
    for (auto parent = control.Parent(); parent; parent = parent->Parent()) {
        if (parent->IsPageContainer()) {
            return true;
        }
    }
    return false;
}
}  // namespace

void NativeWindow::closeEvent(QCloseEvent* event) {
    event->accept();
    if (auto owner = owner_.lock()) {
        owner->NativeClosed();
    }
}

bool ClientArea::focusNextPrevChild(bool next) {
    const auto owner = owner_.lock();
    return owner && MoveFocus(owner->Controls(), next);
}

void NativeWindow::keyPressEvent(QKeyEvent* event) {
    const bool plain = (event->modifiers() & ~Qt::KeypadModifier) == Qt::NoModifier;
    const bool returnKey = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    if (auto owner = owner_.lock(); owner && plain && returnKey) {
        for (const auto& control : owner->Controls()) {
            if (control->PressAsDefault()) {
                event->accept();
                return;
            }
        }
    }
    QMainWindow::keyPressEvent(event);
}

Window::Window(std::string className) : className_(std::move(className)) {}

Window::~Window() {
    for (auto& control : controls_) {
        control->DetachWidget();
    }
    if (native_) {
        // This may run inside the native window's own close event: let Qt delete it later.
        native_->hide();
        native_->deleteLater();
    }
}

void Window::Constructor() {
    RequireMainThread();
    native_ = new NativeWindow(weak_from_this());
    native_->setAttribute(Qt::WA_DeleteOnClose, false);
    client_ = new ClientArea(weak_from_this());
    client_->setAutoFillBackground(true);
    native_->setCentralWidget(client_);
    native_->layout()->setSizeConstraint(QLayout::SetFixedSize);
    // A fixed window with a title bar and a close button as its only window button.
    native_->setWindowFlags(Qt::Window | Qt::CustomizeWindowHint | Qt::WindowTitleHint |
                            Qt::WindowCloseButtonHint);

    Layout();
    CreateControls();
    built_ = true;
    UpdateVisibility();
    NameByNeighbours(controls_);

    // The windows hold the application's objects, which must go before the Qt application.
    static const bool releasedAtFinalize = (RuntimeAtFinalize(ReleaseAllWindows), true);
    (void)releasedAtFinalize;
    openWindows.push_back(shared_from_this());
    open_ = true;
    for (const auto& control : controls_) {
        RaiseEvent([&control] { control->RaiseOpen(); });
    }
    RaiseEvent([this] { Event_Open(); });
    if (PropertyOr<bool>("Visible")) {
        native_->show();
    }
}

void Window::SetProperty(const std::string& name, const PropertyValue& value) {
    PropertyObject::SetProperty(name, value);
    if (!native_) {
        return;
    }
    if (name == "Title") {
        native_->setWindowTitle(QString::fromStdString(std::get<std::string>(value)));
    } else if (name == "Width" || name == "Height") {
        client_->setFixedSize(static_cast<int>(PropertyOr<long long>("Width")),
                              static_cast<int>(PropertyOr<long long>("Height")));
    } else if (name == "BackColor") {
        SetBackColor(std::get<ColorWord>(value).value);
    } else if (name == "MenuBarVisible" && native_->menuWidget()) {
        native_->menuWidget()->setVisible(std::get<bool>(value));
    }
}

void Window::SetBackColor(Color color) {
    RequireMainThread();
    backColor_ = color;
    if (client_) {
        QPalette palette = client_->palette();
        palette.setColor(QPalette::Window, ToQColor(color));
        client_->setPalette(palette);
        client_->update();
    }
}

void Window::SetMenuBar(Ref<::MenuBar> menuBar) {
    RequireMainThread();
    menuBar_ = std::move(menuBar);
    if (native_ && menuBar_) {
        native_->setMenuBar(BuildNativeMenuBar(*menuBar_));
    }
}

void Window::_AddControl(const Ref<Control>& control, const std::string& name) {
    RequireMainThread();
    control->SetProperty("Name", name);
    controls_.push_back(control);
    control->AttachTo(shared_from_this());
}

const Ref<Control>& Window::_ControlByName(std::string_view name) const {
    static const Ref<Control> kNone;
    RequireMainThread();
    for (const auto& control : controls_) {
        if (control->Name() == name) {
            return control;
        }
    }
    return kNone;
}

Ref<Control> Window::_ControlByNameIndex(const std::string& name, long long index) const {
    RequireMainThread();
    for (const auto& control : controls_) {
        if (control->Name() == name && control->Index() == index) {
            return control;
        }
    }
    return nullptr;
}

void Window::Close() {
    RequireMainThread();
    if (native_) {
        native_->close();
    }
}

QWidget* Window::Native() const {
    return native_;
}

// While the controls are being built, each page, parent and visibility property would show and
// hide them all again; the window shows the right ones once, when all are there. A page that
// comes into view takes the focus at its first control when the focus goes out of view or the
// window has none yet; focus elsewhere, as on the segments that chose the page, stays.
void Window::UpdateVisibility() {
    if (!built_) {
        return;
    }
    QWidget* focus = native_->focusWidget();
    const Control* focused = OwnerOf(controls_, focus);
    const bool focusLeaves = !focus || (focused && !focused->IsShown());
    std::vector<const Control*> coming;
    for (const auto& control : controls_) {
        const QWidget* widget = control->Widget();
        if (control->IsShown() && (!widget || widget->isHidden()) && LiesOnPage(*control)) {
            coming.push_back(&control.Get());
        }
    }
    if (focusLeaves && focus) {
        // Hidden with the focus, a widget would pass it on to the next control in the order:
        // a screen reader would speak that one on the way.
        focus->clearFocus();
    }
    for (const auto& control : controls_) {
        if (QWidget* widget = control->Widget()) {
            const bool shown = control->IsShown();
            if (shown) {
                control->ApplyPendingFont();
            }
            widget->setVisible(shown);
        }
    }
    if (focusLeaves) {
        FocusFirstOf(controls_, coming);
    }
}

void Window::NativeClosed() {
    open_ = false;
    // Keep this object alive until the end of this call, even if the registry held the last
    // reference.
    auto self = shared_from_this();
    openWindows.erase(std::remove(openWindows.begin(), openWindows.end(), self), openWindows.end());
}

void ReleaseAllWindows() {
    openWindows.clear();
}

Ref<Window> _GetImplicitWindow(const std::string& className) {
    RequireMainThread();
    for (const auto& window : openWindows) {
        if (window->ClassName() == className && window->IsOpen()) {
            return window;
        }
    }
    return nullptr;
}
