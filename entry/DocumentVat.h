// SPDX-License-Identifier: MIT
#pragma once

#include "platform/core/Single.h"

namespace entry {

/// The VAT contained in a document's value, to the cent, halves to the even neighbour:
/// value - value / (1 + rate / 100).
/// @param value  VAT included
/// @param rate   0..100, a percentage
/// Fails with Overflow past the range of a 32-bit number of cents.
double vatOf(core::Single value, double rate);

}  // namespace entry
