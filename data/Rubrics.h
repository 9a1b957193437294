// SPDX-License-Identifier: MIT
#pragma once

namespace data {

/// True for a share that a rubric may pay: a fraction from 0 to 1, both of them included.
constexpr bool isPercent(double fraction) {
    return fraction >= 0 && fraction <= 1;
}

}  // namespace data
