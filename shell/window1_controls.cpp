// The control table of Window1: every control's class, place and start values, in the order
// of creation, and the eight handler bindings. Each row becomes a property block.
#include <utility>
#include <vector>

#include "drawing/rect_box.h"
#include "platform/core/property_block.h"
#include "shell/window1.h"

namespace {

enum class Kind {
    PagePanel,
    RectBox,
    PushButton,
    PopupMenu,
    Label,
    Label5,
    Label6,
    Listbox,
    TabPanel,
    TextArea,
    SegmentedControl
};

constexpr long long kNoPage = 0;  // TabPanelIndex of controls that lie on no page
constexpr int kNoAlign = -1;
constexpr int kLeft = 0, kCentre = 1, kRight = 2;

using Entries = std::vector<std::pair<std::string, PropertyValue>>;

struct ControlRow {
    const char* name;
    long long index;
    Kind kind;
    const char* parent;  // "" for the window
    long long tabPanelIndex;
    long long left, top, width, height;
    long long tabIndex;
    const char* font;  // "" for none
    float size;
    int align;
    std::string text;
    Entries extra;
};

const std::string kLabel1Text =
    "Depending on which version of Acrobat or Illustrator you have any plugins need installing "
    "in different places.\r\rThis is why we have created this installer for you.\r\rSimply "
    "choose your version of your Adobe product below and click Install, you will need to "
    "restart your Adobe application to see the plugin.";

Entries RectBoxExtras(Color colour) {
    return {{"colour", ColorWord{colour}}, {"linesize", 3LL},     {"Transparent", true},
            {"AcceptFocus", false},        {"AcceptTabs", false}, {"DoubleBuffer", false},
            {"EraseBackground", true},     {"UseFocusRing", true}};
}

Entries ButtonExtras(bool isDefault) {
    return {{"Default", isDefault}, {"Cancel", false}, {"ButtonStyle", 0LL}};
}

Entries TextAreaExtras() {
    return {{"Border", true},
            {"Multiline", true},
            {"ScrollbarHorizontal", false},
            {"ScrollbarVertical", true},
            {"Styled", true},
            {"UseFocusRing", false},
            {"TextColor", ColorWord{0x000000}},
            {"BackColor", ColorWord{0xFFFFFF}},
            {"HideSelection", true},
            {"LineHeight", 0.0},
            {"LineSpacing", 1.0},
            {"ReadOnly", true},
            {"LimitText", 0LL},
            {"AcceptTabs", false},
            {"AutomaticallyCheckSpelling", false},
            {"Format", std::string()},
            {"Mask", std::string()}};
}

Entries ListboxExtras() {
    return {{"ColumnCount", 4LL},         {"ColumnWidths", std::string("200,325,300,50")},
            {"HasHeading", true},         {"HeadingIndex", -1LL},
            {"DefaultRowHeight", 25LL},   {"Border", true},
            {"UseFocusRing", true},       {"ScrollbarHorizontal", false},
            {"ScrollBarVertical", true},  {"AutoHideScrollbars", true},
            {"GridLinesHorizontal", 0LL}, {"GridLinesVertical", 0LL},
            {"SelectionType", 0LL},       {"RequiresSelection", false},
            {"ColumnsResizable", false},  {"Hierarchical", false},
            {"EnableDrag", false},        {"EnableDragReorder", false},
            {"ShowDropIndicator", false}};
}

const std::vector<ControlRow>& ControlTable() {
    using K = Kind;
    // clang-format off
    static const std::vector<ControlRow> table = {
        // name, index, class, parent, TabPanelIndex, left, top, width, height, TabIndex, font, size, alignment, text, differences
        {"PagePanel1", Control::kNoIndex, K::PagePanel, "", kNoPage, 20, 56, 928, 552, 1, "", 0, kNoAlign, "",
         {{"PanelCount", 3LL}, {"Value", 0LL}}},
        {"Canvas3", Control::kNoIndex, K::RectBox, "PagePanel1", 1, 57, 95, 871, 461, 4, "", 0, kNoAlign, "Verifier Installation",
         RectBoxExtras(0x225684)},
        {"PushButton1", Control::kNoIndex, K::PushButton, "Canvas3", 1, 359, 471, 249, 20, 0, "System", 0, kNoAlign, "Install Now",
         ButtonExtras(true)},
        {"PopupMenu1", Control::kNoIndex, K::PopupMenu, "Canvas3", 1, 359, 398, 249, 20, 1, "System", 0, kNoAlign, "Choose Your Adobe Product",
         {{"ListIndex", 0LL}}},
        {"Label1", Control::kNoIndex, K::Label, "Canvas3", 1, 123, 223, 705, 132, 2, "Arial", 14, kCentre, kLabel1Text,
         {{"Multiline", true}, {"Transparent", true}}},
        {"Label2", Control::kNoIndex, K::Label, "Canvas3", 1, 272, 154, 422, 43, 3, "Arial", 24, kCentre, "Verifier Plugin Installation",
         {{"Bold", true}, {"Enabled", false}}},
        {"Canvas2", Control::kNoIndex, K::RectBox, "PagePanel1", 2, 40, 76, 897, 520, 2, "", 0, kNoAlign, "Verification Results",
         RectBoxExtras(0x3F0165)},
        {"Label3", Control::kNoIndex, K::Label, "Canvas2", 2, 60, 108, 866, 35, 0, "Arial", 18, kCentre, "Double Click on a result to see the full report", {}},
        {"Canvas1", Control::kNoIndex, K::RectBox, "PagePanel1", 3, 52, 101, 876, 436, 20, "", 0, kNoAlign, "Barcode Verification Results",
         RectBoxExtras(0x82A343)},
        {"Listbox1", Control::kNoIndex, K::Listbox, "PagePanel1", 2, 52, 151, 876, 429, 0, "System", 0, kNoAlign, "Date - Time\tDocument\tRead Value\tGrade",
         ListboxExtras()},
        {"Label4", Control::kNoIndex, K::Label, "PagePanel1", 3, 217, 69, 533, 20, 0, "Arial", 18, kCentre, "Stored Verification Results", {}},
        {"PushButton2", Control::kNoIndex, K::PushButton, "PagePanel1", 3, 827, 556, 80, 20, 1, "System", 0, kNoAlign, "Close",
         ButtonExtras(false)},
        {"TabPanel1", Control::kNoIndex, K::TabPanel, "PagePanel1", 3, 464, 128, 443, 401, 2, "System", 0, kNoAlign, "Measurements\rDeviances",
         {{"SmallTabs", false}, {"Value", 0LL}}},
        {"TextArea1", Control::kNoIndex, K::TextArea, "TabPanel1", 1, 501, 177, 386, 332, 0, "Courier", 0, kLeft, "", TextAreaExtras()},
        {"TextArea2", Control::kNoIndex, K::TextArea, "TabPanel1", 2, 484, 177, 403, 332, 0, "Courier", 0, kLeft, "", TextAreaExtras()},
        {"Label5", 0, K::Label5, "PagePanel1", 3, 70, 211, 100, 20, 3, "Arial", 12, kRight, "Code Type", {}},
        {"Label6", 0, K::Label6, "PagePanel1", 3, 185, 211, 201, 20, 4, "Arial", 12, kLeft, "Code Type", {}},
        {"Label5", 1, K::Label5, "PagePanel1", 3, 70, 235, 100, 20, 5, "Arial", 12, kRight, "Code Reads", {}},
        {"Label6", 1, K::Label6, "PagePanel1", 3, 185, 235, 201, 20, 6, "Arial", 12, kLeft, "Code Type", {}},
        {"Label5", 2, K::Label5, "PagePanel1", 3, 70, 260, 100, 20, 7, "Arial", 12, kRight, "Symbol Length", {}},
        {"Label6", 2, K::Label6, "PagePanel1", 3, 185, 260, 201, 20, 8, "Arial", 12, kLeft, "Code Type", {}},
        {"Label5", 3, K::Label5, "PagePanel1", 3, 70, 284, 100, 20, 9, "Arial", 12, kRight, "Scale", {}},
        {"Label6", 3, K::Label6, "PagePanel1", 3, 185, 284, 201, 20, 10, "Arial", 12, kLeft, "Code Type", {}},
        {"Label5", 4, K::Label5, "PagePanel1", 3, 70, 307, 100, 20, 11, "Arial", 12, kRight, "BWR", {}},
        {"Label6", 4, K::Label6, "PagePanel1", 3, 185, 307, 201, 20, 12, "Arial", 12, kLeft, "Code Type", {}},
        {"Label5", 5, K::Label5, "PagePanel1", 3, 70, 331, 100, 20, 13, "Arial", 12, kRight, "Bar Deviance", {}},
        {"Label6", 5, K::Label6, "PagePanel1", 3, 185, 331, 201, 20, 14, "Arial", 12, kLeft, "Code Type", {}},
        {"Label6", 6, K::Label6, "PagePanel1", 3, 82, 363, 322, 20, 15, "Arial", 12, kCentre, "Code Type", {}},
        {"Label5", 6, K::Label5, "PagePanel1", 3, 70, 164, 100, 20, 16, "Arial", 12, kRight, "Document", {}},
        {"Label6", 7, K::Label6, "PagePanel1", 3, 185, 164, 201, 49, 17, "Arial", 12, kLeft, "Code Type",
         {{"Multiline", true}}},
        {"Label5", 7, K::Label5, "PagePanel1", 3, 70, 395, 100, 20, 18, "Arial", 12, kRight, "Grade", {}},
        {"Label6", 8, K::Label6, "PagePanel1", 3, 185, 395, 201, 20, 19, "Arial", 12, kLeft, "Code Type", {}},
        {"MainTabs", Control::kNoIndex, K::SegmentedControl, "", kNoPage, 20, 20, 921, 24, 0, "", 0, kNoAlign, "",
         {{"LockRight", true}, {"MacControlStyle", 0LL}, {"SelectionType", 0LL}}},
    };
    // clang-format on
    return table;
}

Ref<Control> Make(Kind kind, long long index) {
    switch (kind) {
        case Kind::PagePanel:
            return New<PagePanel>();
        case Kind::RectBox:
            return New<RectBox>();
        case Kind::PushButton:
            return New<PushButton>();
        case Kind::PopupMenu:
            return New<PopupMenu>();
        case Kind::Label:
            return New<Label>();
        case Kind::Label5:
            return New<Window1_Label5>(index);
        case Kind::Label6:
            return New<Window1_Label6>(index);
        case Kind::Listbox:
            return New<Listbox>();
        case Kind::TabPanel:
            return New<TabPanel>();
        case Kind::TextArea:
            return New<TextArea>();
        case Kind::SegmentedControl:
            return New<SegmentedControl>();
    }
    return nullptr;
}

// The property that a control's text goes to.
const char* TextProperty(Kind kind) {
    switch (kind) {
        case Kind::RectBox:
            return "title";
        case Kind::PushButton:
            return "Caption";
        case Kind::PopupMenu:
        case Kind::Listbox:
            return "InitialValue";
        case Kind::TabPanel:
            return "TabDefinition";
        default:
            return "Text";
    }
}

void Put(Entries& entries, const std::string& name, PropertyValue value) {
    for (auto& entry : entries) {
        if (entry.first == name) {
            entry.second = std::move(value);
            return;
        }
    }
    entries.emplace_back(name, std::move(value));
}

void Remove(Entries& entries, const std::string& name) {
    std::erase_if(entries, [&](const auto& entry) { return entry.first == name; });
}

bool IsLabel(Kind kind) {
    return kind == Kind::Label || kind == Kind::Label5 || kind == Kind::Label6;
}

// The row's start values: its own place, the values common to all rows, then its differences.
std::string PropertiesOf(const ControlRow& row) {
    Entries entries = {{"Name", std::string(row.name)},
                       {"Index", row.index},
                       {"Left", row.left},
                       {"Top", row.top},
                       {"Width", row.width},
                       {"Height", row.height},
                       {"TabPanelIndex", row.tabPanelIndex},
                       {"TabIndex", row.tabIndex}};
    if (*row.parent) {
        Put(entries, "InitialParent", std::string(row.parent));
    }
    for (const char* name :
         {"LockLeft", "LockTop", "Visible", "Enabled", "AutoDeactivate", "TabStop"}) {
        Put(entries, name, true);
    }
    for (const char* name : {"LockRight", "LockBottom", "Italic", "Underline", "Transparent"}) {
        Put(entries, name, false);
    }
    Put(entries, "TextUnit", 0LL);
    for (const char* name : {"HelpTag", "DataSource", "DataField"}) {
        Put(entries, name, std::string());
    }
    if (*row.font) {
        Put(entries, "TextFont", std::string(row.font));
        Put(entries, "TextSize", row.size);
    }
    if (IsLabel(row.kind)) {
        Put(entries, "TextAlign", static_cast<long long>(row.align));
        Put(entries, "TextColor", ColorWord{0x000000});
        Put(entries, "Selectable", false);
        Put(entries, "Multiline", false);
    } else if (row.kind == Kind::TextArea) {
        Put(entries, "Alignment", static_cast<long long>(row.align));
    }
    if (row.kind != Kind::PagePanel && row.kind != Kind::SegmentedControl) {
        Put(entries, TextProperty(row.kind), row.text);
    }
    for (const auto& [name, value] : row.extra) {
        Put(entries, name, value);
    }
    if (row.kind == Kind::PagePanel || row.kind == Kind::SegmentedControl) {
        Remove(entries, "TabStop");
    }
    if (row.kind == Kind::SegmentedControl) {
        Remove(entries, "AutoDeactivate");
        Remove(entries, "HelpTag");
    }
    PropertyBlock block;
    for (const auto& [name, value] : entries) {
        block.Add(name, value);
    }
    return block.Bytes();
}

// The row of a control by its name and, in a control set, its index.
const ControlRow& RowNamed(std::string_view name, long long index = Control::kNoIndex) {
    for (const ControlRow& row : ControlTable()) {
        if (row.name == name && row.index == index) {
            return row;
        }
    }
    throw OutOfBoundsException("No control row " + std::string(name));
}

// One row: allocate, enter under its name, look it up again and give it its properties.
Ref<Control> CreateRow(class Window1& window, const ControlRow& row) {
    window._AddControl(Make(row.kind, row.index), row.name);
    Ref<Control> control = row.index == Control::kNoIndex
                               ? window._ControlByName(row.name)
                               : window._ControlByNameIndex(row.name, row.index);
    _SetProperties(*control, PropertiesOf(row));
    return control;
}

}  // namespace

void Window1::CreateControls() {
    _CreateControls0();
    _CreateControls1();
}

// The rows up to the seventh element of Label6. Handlers are bound after the properties, so
// that PagePanel1's Value 0 raises no Change.
void Window1::_CreateControls0() {
    const ControlRow& last = RowNamed("Label6", 7);
    for (const ControlRow& row : ControlTable()) {
        BindHandlers(*CreateRow(*this, row));
        if (&row == &last) {
            break;
        }
    }
}

// The last three rows; MainTabs gets its segments before its handler.
void Window1::_CreateControls1() {
    BindHandlers(*CreateRow(*this, RowNamed("Label5", 7)));
    BindHandlers(*CreateRow(*this, RowNamed("Label6", 8)));
    CreateRow(*this, RowNamed("MainTabs"));
    Ref<SegmentedControl> tabs = MainTabs();
    auto installation = New<SegmentedControlItem>();
    installation->SetTitle("Installation");
    installation->SetSelected(true);
    installation->SetWidth(460);
    tabs->Items().Append(installation);
    auto results = New<SegmentedControlItem>();
    results->SetTitle("Verification Results");
    results->SetWidth(460);
    tabs->Items().Append(results);
    tabs->SizeToFit();
    BindHandlers(*tabs);
}

// The eight bindings; no other control has a handler.
void Window1::BindHandlers(Control& control) {
    const std::string& name = control.Name();
    if (name == "PagePanel1") {
        static_cast<PagePanel&>(control).Change = [this](PagePanel& p) { PagePanel1_Change(p); };
    } else if (name == "PushButton1") {
        static_cast<PushButton&>(control).Action = [this](PushButton& b) { PushButton1_Action(b); };
    } else if (name == "PopupMenu1") {
        static_cast<PopupMenu&>(control).Open = [this](PopupMenu& p) { PopupMenu1_Open(p); };
    } else if (name == "Listbox1") {
        auto& list = static_cast<Listbox&>(control);
        list.DoubleClick = [this](Listbox& l) { Listbox1_DoubleClick(l); };
        list.Change = [this](Listbox& l) { Listbox1_Change(l); };
        list.CellBackgroundPaint = [this](Listbox& l, Ref<Graphics> g, long long row,
                                          long long column) {
            return Listbox1_CellBackgroundPaint(l, g, row, column);
        };
    } else if (name == "PushButton2") {
        static_cast<PushButton&>(control).Action = [this](PushButton& b) { PushButton2_Action(b); };
    } else if (name == "MainTabs") {
        static_cast<SegmentedControl&>(control).Action = [this](SegmentedControl& s, long long i) {
            MainTabs_Action(s, i);
        };
    }
}
