// SPDX-License-Identifier: MIT
#pragma once

#include "database/sample/Household.h"
#include "database/sample/Writer.h"

namespace database::sample {

/// Writes the member file with its premiums. Gives the number of households with movements.
int writeMembers(Writer& writer, const BookSizes& sizes, QDate asOf);

}  // namespace database::sample
