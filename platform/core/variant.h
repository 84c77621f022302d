// Variant: the value kept with a list row. Here it always holds a text.
#pragma once

#include <string>

struct Variant {
    std::string text;
};

inline Variant StringToVariant(std::string text) {
    return Variant{std::move(text)};
}
inline std::string VariantToString(const Variant& value) {
    return value.text;
}
