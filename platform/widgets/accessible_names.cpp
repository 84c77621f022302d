// Names and captions from the places of the controls: a form's caption stands at the height of
// its value, to its left, as in the window's control table; the tab is found from the page
// number that a control on a tab panel has.
#include "platform/widgets/accessible_names.h"

#include <QLabel>
#include <QTabWidget>

namespace {

// The title of the tab on which the control lies, or nothing.
QString TabTitle(const Control& control) {
    const auto parent = control.Parent();
    const auto* tabs = parent ? qobject_cast<const QTabWidget*>(parent->Widget()) : nullptr;
    const int tab = static_cast<int>(control.TabPanelIndex()) - 1;
    return tabs && tab >= 0 && tab < tabs->count() ? tabs->tabText(tab) : QString();
}

// The nearest control to the right of the label on its row, with the same parent and page.
const Control* Captioned(const std::vector<Ref<Control>>& controls, const Control& label) {
    const Control* nearest = nullptr;
    for (const auto& control : controls) {
        const bool onRow = control->Top() == label.Top() &&
                           control->Left() >= label.Left() + label.Width() &&
                           control->TabPanelIndex() == label.TabPanelIndex() &&
                           control->Parent() == label.Parent();
        if (onRow && (!nearest || control->Left() < nearest->Left())) {
            nearest = &control.Get();
        }
    }
    return nearest;
}

}  // namespace

void NameByNeighbours(const std::vector<Ref<Control>>& controls) {
    for (const auto& control : controls) {
        QWidget* widget = control->Widget();
        if (!widget) {
            continue;
        }
        if (const QString title = TabTitle(*control);
            !title.isEmpty() && widget->accessibleName().isEmpty()) {
            widget->setAccessibleName(title);
        }
        auto* label = qobject_cast<QLabel*>(widget);
        const Control* value = label ? Captioned(controls, *control) : nullptr;
        if (value && value->Widget() && label->buddy() != value->Widget()) {
            label->setBuddy(value->Widget());
        }
    }
}
