// SPDX-License-Identifier: MIT
#pragma once

#include "database/Book.h"
#include "platform/ado/engine/BulkAccess.h"

namespace database::sample {

/// Adds the whole content of a sample book, within a transaction that fills it; an invalid day is
/// today. Memory grows by one amount a member and no more.
void fill(ado::BulkAccess& book, const BookSizes& sizes, QDate asOf);

}  // namespace database::sample
