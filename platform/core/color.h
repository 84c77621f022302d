// Colour words: 0xTTRRGGBB, transparency in the top byte, 0 being opaque.
#pragma once

#include <cstdint>

using Color = std::uint32_t;

constexpr Color RGB(int red, int green, int blue, int transparency = 0) {
    return (static_cast<Color>(transparency & 0xFF) << 24) |
           (static_cast<Color>(red & 0xFF) << 16) | (static_cast<Color>(green & 0xFF) << 8) |
           static_cast<Color>(blue & 0xFF);
}
constexpr int Red(Color c) {
    return (c >> 16) & 0xFF;
}
constexpr int Green(Color c) {
    return (c >> 8) & 0xFF;
}
constexpr int Blue(Color c) {
    return c & 0xFF;
}
constexpr int Transparency(Color c) {
    return (c >> 24) & 0xFF;
}
