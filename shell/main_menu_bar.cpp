// The File and Edit menus.
#include "shell/main_menu_bar.h"

namespace {

struct MenuRow {
    const char* name;
    const char* text;
    const char* shortcut;  // nullptr: the shortcut is not set at all
};

constexpr MenuRow kFileMenu{"FileMenu", "&File", ""};
constexpr MenuRow kFileQuit{"FileQuit", "&Quit", "Cmd+Q"};
constexpr MenuRow kEditMenu{"EditMenu", "&Edit", ""};
constexpr MenuRow kEditItems[] = {
    {"EditUndo", "&Undo", "Cmd+Z"},   {"EditSeparator1", "-", nullptr},
    {"EditCut", "Cu&t", "Cmd+X"},     {"EditCopy", "&Copy", "Cmd+C"},
    {"EditPaste", "&Paste", "Cmd+V"}, {"EditClear", "&Delete", ""},
    {"EditSeparator2", "-", nullptr}, {"EditSelectAll", "Select &All", "Cmd+A"},
};

// Sets Name, AutoEnable, Text, Visible and KeyboardShortcut, in this order.
template <class Item = MenuItem>
Ref<MenuItem> MakeItem(const MenuRow& row) {
    Ref<MenuItem> item = New<Item>();
    item->Name = row.name;
    item->AutoEnable = true;
    item->Text = row.text;
    item->Visible = true;
    if (row.shortcut) {
        item->KeyboardShortcut = row.shortcut;
    }
    return item;
}

}  // namespace

MainMenuBar::MainMenuBar() {
    Untitled0();
    Untitled1();
}

void MainMenuBar::Untitled0() {
    Append(MakeItem(kFileMenu));
    Child("FileMenu")->Append(MakeItem<QuitMenuItem>(kFileQuit));
}

void MainMenuBar::Untitled1() {
    Append(MakeItem(kEditMenu));
    for (const MenuRow& row : kEditItems) {
        Child("EditMenu")->Append(MakeItem(row));
    }
}

Ref<class MainMenuBar> MainMenuBar() {
    static Ref<class MainMenuBar> instance = New<class MainMenuBar>();
    return instance;
}
