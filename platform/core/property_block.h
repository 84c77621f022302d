// Property blocks: the packed form in which a window or control gets its start values.
// An entry is the name, one blank and the value in the form of the property's type.
#pragma once

#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "platform/core/color.h"

struct ColorWord {
    Color value = 0;
    friend bool operator==(ColorWord a, ColorWord b) { return a.value == b.value; }
};

// Boolean, integer, colour, TextSize, LineHeight/LineSpacing, string.
using PropertyValue = std::variant<bool, long long, ColorWord, float, double, std::string>;

// The type that a property name has in a block; Nothing for a name that no class knows. The
// others stand in the order of PropertyValue's alternatives.
enum class PropertyType { Nothing, Boolean, Integer, Colour, Single, Double, String };
PropertyType TypeOfProperty(std::string_view name);
// Gives a name of a control's own its type, so that blocks can carry it.
void RegisterProperty(std::string_view name, PropertyType type);

// Builds a block. A value of another type than the property's raises, so that every block
// that the program builds is one that _SetProperties can read back.
class PropertyBlock {
  public:
    PropertyBlock& Add(std::string_view name, PropertyValue value);
    const std::string& Bytes() const { return bytes_; }

  private:
    std::string bytes_;
};

std::vector<std::pair<std::string, PropertyValue>> DecodePropertyBlock(std::string_view block);

// Anything that takes start values from a block; it keeps every value it was given.
class PropertyObject {
  public:
    virtual ~PropertyObject() = default;
    virtual void SetProperty(const std::string& name, const PropertyValue& value);
    // Called once a whole block is applied, for work that needs several of its values.
    virtual void PropertiesApplied() {}

    const PropertyValue* Property(const std::string& name) const;
    // The value given under that name if it has the type T, else `absent`.
    template <class T>
    T PropertyOr(const std::string& name, T absent = T()) const {
        const PropertyValue* value = Property(name);
        return value && std::holds_alternative<T>(*value) ? std::get<T>(*value) : absent;
    }

  private:
    std::map<std::string, PropertyValue> properties_;
};

void _SetProperties(PropertyObject& object, std::string_view block);
