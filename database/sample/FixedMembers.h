// SPDX-License-Identifier: MIT
#pragma once

#include "database/sample/Household.h"

namespace database::sample {

/// Describes one of the members at fixed numbers (index from 0), told in database/Book.h.
void describeFixedMember(Household& household, int index, QDate asOf, Random& random);

}  // namespace database::sample
