#pragma once

#include <QColor>
#include <algorithm>
#include <cmath>

namespace kelvo::test {

/// How bright a colour is to the eye, from 0 for black to 1 for white (WCAG 2.1, "relative luminance").
inline double luminance(const QColor& color) {
    const auto linear = [](double share) {
        return share <= 0.04045 ? share / 12.92 : std::pow((share + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * linear(color.redF()) + 0.7152 * linear(color.greenF()) + 0.0722 * linear(color.blueF());
}

/// From 1 for the same brightness to 21 for black on white (WCAG 2.1, "contrast ratio").
inline double contrast(const QColor& a, const QColor& b) {
    const auto [dark, light] = std::minmax({luminance(a), luminance(b)});
    return (light + 0.05) / (dark + 0.05);
}

}  // namespace kelvo::test
