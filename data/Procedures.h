// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

#include "platform/core/Single.h"

namespace data {

/// The name under which the operating system's user logged in; empty when the system knows none,
/// and for a name of more than 24 characters.
QString ObterUtilizador();

/// The smaller of two numbers: `a` if it is less than `b`, otherwise `b`.
inline core::Single MinSingle(core::Single a, core::Single b) {
    return a < b ? a : b;
}
/// The larger of two numbers: `b` if `a` is less than `b`, otherwise `a`.
inline core::Single MaxSingle(core::Single a, core::Single b) {
    return a < b ? b : a;
}

}  // namespace data
