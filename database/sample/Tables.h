// SPDX-License-Identifier: MIT
#pragma once

#include "database/BookWriter.h"

/// The tables that the sample fills, with the columns it writes. `left` chooses the twin that
/// holds members who have left.
namespace database::sample::tables {

const Table& members(bool left);
const Table& persons(bool left);
const Table& movements(bool left);
const Table& accumulators(bool left);
const Table& history();
const Table& premiums();
const Table& premiumPayments();
const Table& rubrics();
const Table& hospitals();
const Table& counters();
const Table& cheques();

}  // namespace database::sample::tables
