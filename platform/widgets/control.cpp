// Control: placement at window coordinates, page visibility, fonts and the common properties.
#include "platform/widgets/control.h"

#include <QAbstractScrollArea>
#include <QApplication>
#include <QFont>
#include <QWidget>

#include <cmath>

#include "platform/runtime/main_thread.h"
#include "platform/widgets/desktop_colors.h"
#include "platform/widgets/qt_font.h"

Control::Control() : context_(std::make_unique<QObject>()) {}

Control::~Control() {
    if (widget_ && !widgetAdopted_) {
        delete widget_;
    }
}

void Control::SetProperty(const std::string& name, const PropertyValue& value) {
    PropertyObject::SetProperty(name, value);
    if (name == "Name") {
        name_ = std::get<std::string>(value);
    } else if (name == "Index") {
        index_ = std::get<long long>(value);
    } else if (name == "Left" || name == "Top" || name == "Width" || name == "Height") {
        const int v = static_cast<int>(std::get<long long>(value));
        (name == "Left" ? left_ : name == "Top" ? top_ : name == "Width" ? width_ : height_) = v;
        Place();
    } else if (name == "TabPanelIndex" || name == "Visible" || name == "InitialParent") {
        if (name == "TabPanelIndex") {
            tabPanelIndex_ = std::get<long long>(value);
        } else if (name == "Visible") {
            visible_ = std::get<bool>(value);
        } else {
            initialParent_ = std::get<std::string>(value);
        }
        if (auto window = window_.lock()) {
            window->UpdateVisibility();
        }
    } else if (widget_) {
        ApplyCommon(name, value);
    }
}

void Control::ApplyCommon(const std::string& name, const PropertyValue& value) {
    if (name == "Enabled") {
        widget_->setEnabled(std::get<bool>(value));
    } else if (name == "HelpTag") {
        widget_->setToolTip(QString::fromStdString(std::get<std::string>(value)));
    } else if (name == "TextColor" || name == "BackColor") {
        ShowStoredColors(*widget_, *this);
    } else if (auto* area = qobject_cast<QAbstractScrollArea*>(widget_); area && name == "Border") {
        area->setFrameShape(std::get<bool>(value) ? QFrame::StyledPanel : QFrame::NoFrame);
    } else if (area && (name == "ScrollBarVertical" || name == "ScrollbarVertical")) {
        area->setVerticalScrollBarPolicy(std::get<bool>(value) ? Qt::ScrollBarAsNeeded
                                                               : Qt::ScrollBarAlwaysOff);
    }
}

// The font is set once for the whole block: each setFont relays the widget out.
void Control::PropertiesApplied() {
    for (const char* name : {"TextFont", "TextSize", "Bold", "Italic", "Underline"}) {
        if (Property(name)) {
            fontPending_ = true;
            if (IsShown()) {
                ApplyPendingFont();
            }
            return;
        }
    }
}

// A font is looked up and loaded at its first use: the controls of the pages not shown at
// start get theirs when first shown: 11% fewer instructions from start to a painted window.
void Control::ApplyPendingFont() {
    if (fontPending_ && widget_) {
        fontPending_ = false;
        SetWidgetFont();
    }
}

void Control::SetAccessibleName(const std::string& name) {
    LiveWidget().setAccessibleName(QString::fromStdString(name));
}

bool Control::IsShown() const {
    if (!visible_) {
        return false;
    }
    for (auto parent = Parent(); parent; parent = parent->Parent()) {
        if (parent->IsPageContainer()) {
            return parent->ShowsPage(tabPanelIndex_) && parent->IsShown();
        }
    }
    return true;
}

Ref<Control> Control::Parent() const {
    auto window = window_.lock();
    if (!window || initialParent_.empty()) {
        return nullptr;
    }
    return window->_ControlByName(initialParent_);
}

void Control::AttachTo(const std::shared_ptr<ControlHost>& window) {
    window_ = window;
    if (widget_) {
        widget_->setParent(window->Client());
        widgetAdopted_ = true;
        Place();
    }
}

void Control::SetWidget(QWidget* widget) {
    widget_ = widget;
}

QWidget& Control::LiveWidget() const {
    RequireMainThread();
    if (!widget_) {
        throw NilObjectException("The control's window is gone");
    }
    return *widget_;
}

// Sizes are pixels, as on the desktop that the window was designed for; 0 is the default.
void Control::SetWidgetFont() {
    QFont font = QApplication::font();
    SetFontFamily(font, PropertyOr<std::string>("TextFont"));
    if (const float size = PropertyOr<float>("TextSize"); size > 0) {
        font.setPixelSize(static_cast<int>(std::lround(size)));
    }
    font.setBold(PropertyOr<bool>("Bold"));
    font.setItalic(PropertyOr<bool>("Italic"));
    font.setUnderline(PropertyOr<bool>("Underline"));
    widget_->setFont(font);
}

void Control::Place() {
    if (widget_) {
        widget_->setGeometry(left_, top_, width_, height_);
    }
}
