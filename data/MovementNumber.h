// SPDX-License-Identifier: MIT
#pragma once

#include <QStringView>

namespace data {

/// One row: the counters.
inline constexpr QStringView CounterQuery = u"select * from tbContadores";

/// Draws the next movement number from the counter, whose row is held meanwhile, so that no other
/// workstation is given the same. Fails when what follows it cannot be stored.
///
/// A counter without a row gives the number 1 and stores 1, so the next draw gives 1 once more.
/// This repetition is meant to stay.
qint32 drawMovementNumber();

}  // namespace data
