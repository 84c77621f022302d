// Focus order over the control table: each control's place is the chain of TabIndex values
// from the window down to it, so a container's controls come together at the container's place.
#include "platform/widgets/focus_order.h"

#include <QApplication>
#include <QWidget>

#include <algorithm>

namespace {

std::vector<long long> TabPath(const Control& control) {
    std::vector<long long> path{control.PropertyOr<long long>("TabIndex")};
    for (auto above = control.Parent(); above; above = above->Parent()) {
        path.push_back(above->PropertyOr<long long>("TabIndex"));
    }
    std::reverse(path.begin(), path.end());
    return path;
}

bool TakesTab(const QWidget& widget) {
    return (widget.focusPolicy() & Qt::TabFocus) == Qt::TabFocus && widget.isEnabled();
}

}  // namespace

std::vector<QWidget*> FocusOrder(const std::vector<Ref<Control>>& controls) {
    std::vector<std::pair<std::vector<long long>, const Control*>> placed;
    for (const auto& control : controls) {
        if (control->IsShown() && control->PropertyOr<bool>("TabStop", true) && control->Widget()) {
            placed.emplace_back(TabPath(*control), &control.Get());
        }
    }
    std::stable_sort(placed.begin(), placed.end(),
                     [](const auto& a, const auto& b) { return a.first < b.first; });
    std::vector<QWidget*> order;
    for (const auto& [path, control] : placed) {
        QWidget* widget = control->Widget();
        if (TakesTab(*widget)) {
            order.push_back(widget);
            continue;
        }
        // A control made of several focusable parts, such as the segments of a row.
        for (QWidget* part : widget->findChildren<QWidget*>(Qt::FindDirectChildrenOnly)) {
            if (TakesTab(*part) && part->isVisibleTo(widget)) {
                order.push_back(part);
            }
        }
    }
    return order;
}

bool MoveFocus(const std::vector<Ref<Control>>& controls, bool forward) {
    const std::vector<QWidget*> order = FocusOrder(controls);
    if (order.empty()) {
        return false;
    }
    const QWidget* focus = QApplication::focusWidget();
    const auto at = std::find_if(order.begin(), order.end(), [focus](const QWidget* widget) {
        return focus && (widget == focus || widget->isAncestorOf(focus));
    });
    const int count = static_cast<int>(order.size());
    int next = forward ? 0 : count - 1;
    if (at != order.end()) {
        next = (static_cast<int>(at - order.begin()) + (forward ? 1 : count - 1)) % count;
    }
    order[static_cast<size_t>(next)]->setFocus(forward ? Qt::TabFocusReason
                                                       : Qt::BacktabFocusReason);
    return true;
}

const Control* OwnerOf(const std::vector<Ref<Control>>& controls, const QWidget* widget) {
    for (const auto& control : controls) {
        const QWidget* own = control->Widget();
        if (widget && own && (own == widget || own->isAncestorOf(widget))) {
            return &control.Get();
        }
    }
    return nullptr;
}

void FocusFirstOf(const std::vector<Ref<Control>>& controls,
                  const std::vector<const Control*>& among) {
    for (QWidget* widget : FocusOrder(controls)) {
        if (std::find(among.begin(), among.end(), OwnerOf(controls, widget)) != among.end()) {
            widget->setFocus(Qt::OtherFocusReason);
            return;
        }
    }
}
