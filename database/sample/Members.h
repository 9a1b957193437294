// SPDX-License-Identifier: MIT
#pragma once

#include "database/BookWriter.h"
#include "database/sample/Household.h"

namespace database::sample {

/// Writes the member file with its premiums. Gives the number of households with movements.
int writeMembers(BookWriter& writer, const BookSizes& sizes, QDate asOf);

}  // namespace database::sample
