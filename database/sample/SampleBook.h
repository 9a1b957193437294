// SPDX-License-Identifier: MIT
#pragma once

#include "database/Book.h"
#include "database/BookWriter.h"

namespace database::sample {

/// Writes the whole content of a sample book. Memory grows by one amount a member and no more.
void fill(BookWriter& writer, const BookSizes& sizes, QDate asOf);

}  // namespace database::sample
