// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "platform/ado/Recordset.h"

/// Row sets as rules and screens open them for themselves, on the connection `MSAccess`.
namespace data {

/// To be read only.
ado::RecordsetPtr openToRead(const QString& statement);

/// To be written: static cursor, pessimistic locks.
ado::RecordsetPtr openToWrite(const QString& statement);

/// Adds to a sum of the current row, or takes from it. A sum with a null stays null, whichever of
/// the two is null.
void add(ado::Recordset& row, const QString& column, const QVariant& amount);
void subtract(ado::Recordset& row, const QString& column, const QVariant& amount);

/// Runs what writes the accumulator of a movement that is in the book by now. A failure is told and
/// goes no further, so that the movement's screen can go: nobody shall type over the movement or
/// annul it twice. The accumulator lags until it is rebuilt. True when it was written.
bool accumulatedOrTold(const std::function<void()>& write);

/// A null in that column of the current row becomes 0.
void nullBecomesZero(ado::Recordset& row, const QString& column);

}  // namespace data
