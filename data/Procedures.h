// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace data {

/// The name under which the operating system's user logged in; empty when the system knows none,
/// and for a name of more than 24 characters.
QString ObterUtilizador();

/// The smaller of two numbers: `a` if it is less than `b`, otherwise `b`.
float MinSingle(float a, float b);
/// The larger of two numbers: `b` if `a` is less than `b`, otherwise `a`.
float MaxSingle(float a, float b);

}  // namespace data
