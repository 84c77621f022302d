// Encoding and decoding of property blocks; the type of each platform property name is fixed
// here, and a control of the program's own adds its names with RegisterProperty.
#include "platform/core/property_block.h"

#include <cstring>

#include "platform/core/exceptions.h"

namespace {

// Looked up by a view of the name, without building a string for it.
using TypeMap = std::map<std::string, PropertyType, std::less<>>;

TypeMap& PropertyTypes() {
    using T = PropertyType;
    static TypeMap types = [] {
        TypeMap map;
        for (auto name : {"Visible",
                          "Enabled",
                          "AutoDeactivate",
                          "TabStop",
                          "Italic",
                          "Underline",
                          "Bold",
                          "Transparent",
                          "LockLeft",
                          "LockTop",
                          "LockRight",
                          "LockBottom",
                          "Multiline",
                          "Default",
                          "Cancel",
                          "HasHeading",
                          "Border",
                          "UseFocusRing",
                          "ScrollbarHorizontal",
                          "ScrollBarVertical",
                          "ScrollbarVertical",
                          "AutoHideScrollbars",
                          "RequiresSelection",
                          "ColumnsResizable",
                          "Hierarchical",
                          "EnableDrag",
                          "EnableDragReorder",
                          "ShowDropIndicator",
                          "Styled",
                          "HideSelection",
                          "ReadOnly",
                          "AcceptTabs",
                          "AutomaticallyCheckSpelling",
                          "AcceptFocus",
                          "DoubleBuffer",
                          "EraseBackground",
                          "SmallTabs",
                          "CloseButton",
                          "Resizeable",
                          "MaximizeButton",
                          "MinimizeButton",
                          "FullScreenButton",
                          "Composite",
                          "LiveResize",
                          "FullScreen",
                          "HasBackColor",
                          "MenuBarVisible",
                          "Selectable"}) {
            map.emplace(name, T::Boolean);
        }
        for (auto name : {"Left",
                          "Top",
                          "Width",
                          "Height",
                          "MinWidth",
                          "MinHeight",
                          "MaxWidth",
                          "MaxHeight",
                          "Frame",
                          "MacProcID",
                          "Placement",
                          "Index",
                          "TabIndex",
                          "TabPanelIndex",
                          "TextUnit",
                          "PanelCount",
                          "Value",
                          "MacControlStyle",
                          "SelectionType",
                          "ButtonStyle",
                          "ListIndex",
                          "TextAlign",
                          "ColumnCount",
                          "HeadingIndex",
                          "DefaultRowHeight",
                          "GridLinesHorizontal",
                          "GridLinesVertical",
                          "LimitText",
                          "Alignment"}) {
            map.emplace(name, T::Integer);
        }
        for (auto name : {"BackColor", "TextColor"}) {
            map.emplace(name, T::Colour);
        }
        map.emplace("TextSize", T::Single);
        map.emplace("LineHeight", T::Double);
        map.emplace("LineSpacing", T::Double);
        for (auto name : {"Title", "Name", "InitialParent", "TextFont", "Text", "HelpTag",
                          "DataSource", "DataField", "InitialValue", "ColumnWidths",
                          "TabDefinition", "Format", "Mask", "Caption"}) {
            map.emplace(name, T::String);
        }
        return map;
    }();
    return types;
}

PropertyType TypeOfValue(const PropertyValue& value) {
    return static_cast<PropertyType>(value.index() + 1);
}

template <class T>
void AppendRaw(std::string& out, T value) {
    char bytes[sizeof(T)];
    std::memcpy(bytes, &value, sizeof(T));  // the host is little-endian, as the format
    out.append(bytes, sizeof(T));
}

template <class T>
T ReadRaw(std::string_view block, size_t& at) {
    if (block.size() - at < sizeof(T)) {
        throw OutOfBoundsException("Property block ends inside a value");
    }
    T value;
    std::memcpy(&value, block.data() + at, sizeof(T));
    at += sizeof(T);
    return value;
}

}  // namespace

PropertyType TypeOfProperty(std::string_view name) {
    const auto& types = PropertyTypes();
    const auto found = types.find(name);
    return found == types.end() ? PropertyType::Nothing : found->second;
}

void RegisterProperty(std::string_view name, PropertyType type) {
    PropertyTypes().insert_or_assign(std::string(name), type);
}

PropertyBlock& PropertyBlock::Add(std::string_view name, PropertyValue value) {
    if (TypeOfProperty(name) != TypeOfValue(value)) {
        throw IllegalCastException("Property " + std::string(name) + " has another type");
    }
    bytes_ += name;
    bytes_ += ' ';
    std::visit(
        [this](const auto& v) {
            using V = std::decay_t<decltype(v)>;
            if constexpr (std::is_same_v<V, bool>) {
                bytes_ += static_cast<char>(v ? 1 : 0);
            } else if constexpr (std::is_same_v<V, ColorWord>) {
                AppendRaw<std::uint32_t>(bytes_, v.value);
            } else if constexpr (std::is_same_v<V, std::string>) {
                AppendRaw<std::uint32_t>(bytes_, static_cast<std::uint32_t>(v.size()));
                bytes_ += v;
            } else {
                AppendRaw<V>(bytes_, v);
            }
        },
        value);
    return *this;
}

std::vector<std::pair<std::string, PropertyValue>> DecodePropertyBlock(std::string_view block) {
    std::vector<std::pair<std::string, PropertyValue>> entries;
    size_t at = 0;
    while (at < block.size()) {
        const size_t blank = block.find(' ', at);
        if (blank == std::string_view::npos) {
            throw OutOfBoundsException("Property block ends inside a name");
        }
        std::string name(block.substr(at, blank - at));
        at = blank + 1;
        PropertyValue value;
        switch (TypeOfProperty(name)) {
            case PropertyType::Boolean:
                value = ReadRaw<char>(block, at) != 0;
                break;
            case PropertyType::Integer:
                value = ReadRaw<long long>(block, at);
                break;
            case PropertyType::Colour:
                value = ColorWord{ReadRaw<std::uint32_t>(block, at)};
                break;
            case PropertyType::Single:
                value = ReadRaw<float>(block, at);
                break;
            case PropertyType::Double:
                value = ReadRaw<double>(block, at);
                break;
            case PropertyType::String: {
                const auto length = ReadRaw<std::uint32_t>(block, at);
                if (block.size() - at < length) {
                    throw OutOfBoundsException("Property block ends inside a string");
                }
                value = std::string(block.substr(at, length));
                at += length;
                break;
            }
            case PropertyType::Nothing:
                throw OutOfBoundsException("Unknown property " + name);
        }
        entries.emplace_back(std::move(name), std::move(value));
    }
    return entries;
}

void PropertyObject::SetProperty(const std::string& name, const PropertyValue& value) {
    properties_[name] = value;
}

const PropertyValue* PropertyObject::Property(const std::string& name) const {
    const auto found = properties_.find(name);
    return found == properties_.end() ? nullptr : &found->second;
}

void _SetProperties(PropertyObject& object, std::string_view block) {
    for (const auto& [name, value] : DecodePropertyBlock(block)) {
        object.SetProperty(name, value);
    }
    object.PropertiesApplied();
}
