// SPDX-License-Identifier: MIT
#pragma once

#include "host/MovementBook.h"
#include "platform/printing/Output.h"

/// Movements of the list on paper and as a text for spreadsheets, in the list's order. One that is
/// gone from the book meanwhile is left out. Failures are core::Failure.
namespace host {

/// Movements that go on paper at most: some 350 pages, which take a second to be laid out.
inline constexpr std::size_t MostPrinted = 20'000;

/// The report of such rows. `filter` stands at its head; empty for none.
printing::Report movementReport(const QString& filter);

/// Its rows, held in memory; null when given up. `goesOn` is told how many were read.
ado::RecordsetPtr movementRows(const MovementBook& book, const std::vector<qint32>& keys,
                               const printing::GoesOn& goesOn);

/// Writes any number of movements, a stretch of them in memory at a time. False when given up, and
/// then there is no file.
bool writeMovements(const MovementBook& book, const std::vector<qint32>& keys, const QString& file,
                    const printing::GoesOn& goesOn);

}  // namespace host
