// Window1: the system's only window, with the installer page, the list page and the report
// page on PagePanel1 and the two segments of MainTabs above them. Every handler is defined in
// shell/, one file a page, and calls down into results/ or installer/.
#pragma once

#include <string>

#include "platform/core/folder_item.h"
#include "platform/widgets/canvas.h"
#include "platform/widgets/controls.h"
#include "platform/widgets/listbox.h"
#include "platform/widgets/menu.h"
#include "platform/widgets/segmented_control.h"
#include "platform/widgets/window.h"

class RectBox;

// The elements of the two label control sets.
class Window1_Label5 : public Label {
  public:
    explicit Window1_Label5(long long index) { SetIndex(index); }
};
class Window1_Label6 : public Label {
  public:
    explicit Window1_Label6(long long index) { SetIndex(index); }
};

class Window1 : public Window {
  public:
    Window1() : Window("Window1.Window1") {}

    void Layout() override;
    void CreateControls() override;
    void _CreateControls0();
    void _CreateControls1();

    Ref<PagePanel> PagePanel1() const { return ControlAs<PagePanel>("PagePanel1"); }
    Ref<RectBox> Canvas3() const;
    Ref<PushButton> PushButton1() const { return ControlAs<PushButton>("PushButton1"); }
    Ref<PopupMenu> PopupMenu1() const { return ControlAs<PopupMenu>("PopupMenu1"); }
    Ref<Label> Label1() const { return ControlAs<Label>("Label1"); }
    Ref<Label> Label2() const { return ControlAs<Label>("Label2"); }
    Ref<RectBox> Canvas2() const;
    Ref<Label> Label3() const { return ControlAs<Label>("Label3"); }
    Ref<RectBox> Canvas1() const;
    Ref<Listbox> Listbox1() const { return ControlAs<Listbox>("Listbox1"); }
    Ref<Label> Label4() const { return ControlAs<Label>("Label4"); }
    Ref<PushButton> PushButton2() const { return ControlAs<PushButton>("PushButton2"); }
    Ref<TabPanel> TabPanel1() const { return ControlAs<TabPanel>("TabPanel1"); }
    Ref<TextArea> TextArea1() const { return ControlAs<TextArea>("TextArea1"); }
    Ref<TextArea> TextArea2() const { return ControlAs<TextArea>("TextArea2"); }
    Ref<Label> Label5(long long index) const { return ControlAs<Label>("Label5", index); }
    Ref<Label> Label6(long long index) const { return ControlAs<Label>("Label6", index); }
    Ref<SegmentedControl> MainTabs() const { return ControlAs<SegmentedControl>("MainTabs"); }

    void PagePanel1_Change(PagePanel& sender);
    void PushButton1_Action(PushButton& sender);
    void PopupMenu1_Open(PopupMenu& sender);
    void Listbox1_DoubleClick(Listbox& sender);
    void Listbox1_Change(Listbox& sender);
    bool Listbox1_CellBackgroundPaint(Listbox& sender, Ref<Graphics> g, long long row,
                                      long long column);
    void PushButton2_Action(PushButton& sender);
    void MainTabs_Action(SegmentedControl& sender, long long segmentIndex);

    Ref<MenuItem> EditMenu() const { return MenuNamed("EditMenu"); }
    Ref<MenuItem> EditSelectAll() const { return MenuNamed("EditSelectAll"); }
    Ref<MenuItem> EditSeparator2() const { return MenuNamed("EditSeparator2"); }
    Ref<MenuItem> EditClear() const { return MenuNamed("EditClear"); }
    Ref<MenuItem> EditPaste() const { return MenuNamed("EditPaste"); }
    Ref<MenuItem> EditCopy() const { return MenuNamed("EditCopy"); }
    Ref<MenuItem> EditCut() const { return MenuNamed("EditCut"); }
    Ref<MenuItem> EditSeparator1() const { return MenuNamed("EditSeparator1"); }
    Ref<MenuItem> EditUndo() const { return MenuNamed("EditUndo"); }
    Ref<MenuItem> FileMenu() const { return MenuNamed("FileMenu"); }
    Ref<QuitMenuItem> FileQuit() const { return Cast<QuitMenuItem>(MenuNamed("FileQuit")); }

    void Event_Open() override;
    // Forwards to the installer's copy, which needs no window.
    void CopyFileOrFolder(Ref<FolderItem> source, Ref<FolderItem> destination);

  private:
    void BindHandlers(Control& control);
    Ref<MenuItem> MenuNamed(const std::string& name) const { return MenuBar()->_Lookup(name); }
};

// The implicit instance: the open Window1, or a new one when none is open. (The accessor
// shares the class's name, so the type is written `class Window1` after this point.)
Ref<class Window1> Window1();
