// SPDX-License-Identifier: MIT
#pragma once

#include <QColor>
#include <cmath>

namespace support {

inline double brightness(const QColor& color) {
    const auto linear = [](double part) {
        return part <= 0.04045 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * linear(color.redF()) + 0.7152 * linear(color.greenF()) +
           0.0722 * linear(color.blueF());
}

/// From 1, the same, to 21, black on white.
inline double contrast(const QColor& a, const QColor& b) {
    const double one = brightness(a) + 0.05;
    const double other = brightness(b) + 0.05;
    return std::max(one / other, other / one);
}

}  // namespace support
