// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <vector>

namespace automation {

/// One press of a key.
struct Stroke {
    quint32 symbol = 0;  ///< what the key says, as X11 numbers it (keysym)
    bool shift = false;
    bool ctrl = false;
    bool alt = false;
    bool operator==(const Stroke&) const = default;
};

/// The presses that a text in the notation of SendKeys() stands for. Fails when it is not in that
/// notation.
std::vector<Stroke> strokesOf(const QString& keys);

}  // namespace automation
