// Menus over QMenuBar. Copy and Select All act on the focused text pane, and Copy also on the
// selected row of a focused list; the other Edit items find nothing to act on, since every text
// in a window is read-only.
#include "platform/widgets/menu.h"

#include <QApplication>
#include <QKeySequence>
#include <QLineEdit>
#include <QMenu>
#include <QMenuBar>

#include "platform/runtime/application.h"
#include "platform/runtime/runtime.h"
#include "platform/widgets/list_view.h"
#include "platform/widgets/text_pane.h"

namespace {

TextPane* FocusedPane() {
    return dynamic_cast<TextPane*>(QApplication::focusWidget());
}

// A focused list offers its selected row to Copy, and nothing to the other Edit items.
ListView* FocusedList() {
    return dynamic_cast<ListView*>(QApplication::focusWidget());
}

// Whether an Edit item has something to act on in the focused control.
bool EditItemApplies(const std::string& name) {
    if (const ListView* list = FocusedList()) {
        return name == "EditCopy" && list->HasSelectedRow();
    }
    if (const TextPane* pane = FocusedPane()) {
        return name == "EditSelectAll" || (name == "EditCopy" && pane->HasSelection());
    }
    return false;
}

bool IsEditItem(const std::string& name) {
    return name == "EditCopy" || name == "EditSelectAll" || name == "EditCut" ||
           name == "EditPaste" || name == "EditUndo" || name == "EditClear";
}

// The open menu shows what applies to the focused control now. Closed, every item stays
// enabled so that its shortcut reaches Action, which checks again.
void EnableEditItems(const QMenu& menu, bool open) {
    for (QAction* action : menu.actions()) {
        const std::string name = action->objectName().toStdString();
        if (IsEditItem(name)) {
            action->setEnabled(!open || EditItemApplies(name));
        }
    }
}

QString QtShortcut(const std::string& shortcut) {
    QString text = QString::fromStdString(shortcut);
    text.replace("Cmd", "Ctrl");  // Qt's Ctrl is the command key on macOS
    return text;
}

void AddItems(QMenu* menu, const MenuItem& parent) {
    for (long long i = 0; i < parent.Count(); ++i) {
        Ref<MenuItem> item = parent.Item(i);
        if (item->Text == "-") {
            menu->addSeparator()->setVisible(item->Visible);
            continue;
        }
        QAction* action = menu->addAction(QString::fromStdString(item->Text));
        action->setObjectName(QString::fromStdString(item->Name));
        action->setVisible(item->Visible);
        action->setShortcut(QKeySequence(QtShortcut(item->KeyboardShortcut)));
        if (dynamic_cast<QuitMenuItem*>(&item.Get())) {
            action->setMenuRole(QAction::QuitRole);
        }
        std::weak_ptr<MenuItem> weak = item.Shared();
        QObject::connect(action, &QAction::triggered, action, [weak] {
            if (auto locked = weak.lock()) {
                RaiseEvent([locked] { locked->Action(); });
            }
        });
    }
    QObject::connect(menu, &QMenu::aboutToShow, menu, [menu] { EnableEditItems(*menu, true); });
    QObject::connect(menu, &QMenu::aboutToHide, menu, [menu] { EnableEditItems(*menu, false); });
}

}  // namespace

Ref<MenuItem> MenuItem::Item(long long index) const {
    if (index < 0 || index >= Count()) {
        throw OutOfBoundsException("Menu item index out of bounds");
    }
    return children_[static_cast<size_t>(index)];
}

Ref<MenuItem> MenuItem::Child(const std::string& name) const {
    for (const auto& child : children_) {
        if (child->Name == name) {
            return child;
        }
    }
    return nullptr;
}

Ref<MenuItem> MenuItem::_Lookup(const std::string& name) const {
    for (const auto& child : children_) {
        if (child->Name == name) {
            return child;
        }
        if (auto found = child->_Lookup(name)) {
            return found;
        }
    }
    return nullptr;
}

void MenuItem::Action() {
    if (!EditItemApplies(Name)) {
        return;
    }
    if (ListView* list = FocusedList()) {
        list->CopySelection();
    } else if (Name == "EditCopy") {
        FocusedPane()->Copy();
    } else {
        FocusedPane()->SelectAll();
    }
}

void QuitMenuItem::Action() {
    QuitMenuAction();
}

QMenuBar* BuildNativeMenuBar(const MenuBar& bar) {
    auto* native = new QMenuBar;
    for (long long i = 0; i < bar.Count(); ++i) {
        Ref<MenuItem> top = bar.Item(i);
        QMenu* menu = native->addMenu(QString::fromStdString(top->Text));
        menu->setObjectName(QString::fromStdString(top->Name));
        menu->menuAction()->setVisible(top->Visible);
        AddItems(menu, *top);
    }
    return native;
}
