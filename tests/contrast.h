// What a person reads off painted pixels: the WCAG contrast of two colours from their relative
// luminance, the ground of an area and the ink that stands out on it.
#pragma once

#include <QImage>

#include <algorithm>
#include <cmath>

#include <map>

namespace testsupport {

inline double Luminance(QRgb colour) {
    const auto linear = [](int channel) {
        const double c = channel / 255.0;
        return c <= 0.04045 ? c / 12.92 : std::pow((c + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * linear(qRed(colour)) + 0.7152 * linear(qGreen(colour)) +
           0.0722 * linear(qBlue(colour));
}

inline double Contrast(QRgb a, QRgb b) {
    const double la = Luminance(a), lb = Luminance(b);
    return (std::max(la, lb) + 0.05) / (std::min(la, lb) + 0.05);
}

// How many pixels of the area have each colour.
inline std::map<QRgb, int> Colours(const QImage& image) {
    std::map<QRgb, int> counts;
    for (int y = 0; y < image.height(); ++y) {
        for (int x = 0; x < image.width(); ++x) {
            ++counts[image.pixel(x, y) | 0xFF000000u];
        }
    }
    return counts;
}

// The colour that covers most of the area.
inline QRgb Ground(const QImage& image) {
    const auto counts = Colours(image);
    return std::max_element(counts.begin(), counts.end(),
                            [](const auto& a, const auto& b) { return a.second < b.second; })
        ->first;
}

// The colour that differs most from the ground: the core of the text's strokes.
inline QRgb Ink(const QImage& image, QRgb ground) {
    QRgb ink = ground;
    for (const auto& [colour, count] : Colours(image)) {
        if (Contrast(colour, ground) > Contrast(ink, ground)) {
            ink = colour;
        }
    }
    return ink;
}

}  // namespace testsupport
