// SPDX-License-Identifier: MIT
#pragma once

#include <compare>

#include "platform/core/Values.h"

namespace core {

/// A 32-bit float, the working type of the plan's calculation. Whatever makes one rounds to the
/// nearest, and fails with Overflow past its range; so each operation below rounds once.
class Single {
public:
    constexpr Single() = default;
    explicit Single(double number) : value_(core::toSingle(number)) {}
    /// The number of a field. Fails as toDouble does.
    explicit Single(const QVariant& value) : value_(core::toSingle(value)) {}

    double toDouble() const { return static_cast<double>(value_); }
    /// As a field or a control takes it.
    operator QVariant() const { return value_; }

    friend Single operator-(Single a, Single b) { return Single(a.toDouble() - b.toDouble()); }
    Single operator-() const { return Single(-toDouble()); }
    friend auto operator<=>(const Single&, const Single&) = default;

private:
    float value_ = 0;
};

}  // namespace core
