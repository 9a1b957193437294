// SPDX-License-Identifier: MIT
#pragma once

#include <QtGlobal>

namespace data {

/// Draws the next movement number from the counter, whose row is held meanwhile, so that no other
/// workstation is given the same.
///
/// @param number  set as soon as the number is known, also when storing the next one then fails
///
/// A counter without a row gives the number 1 and stores 1, so the next draw gives 1 once more.
/// This repetition is meant to stay.
void drawMovementNumber(qint32& number);

}  // namespace data
