// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"

/// Row sets as rules and screens open them for themselves, on the connection `MSAccess`.
namespace data {

/// To be read only.
ado::RecordsetPtr openToRead(const QString& query);

/// To be written: static cursor, pessimistic locks.
ado::RecordsetPtr openToWrite(const QString& query);

/// Adds to a sum of the current row, or takes from it. A sum with a null stays null, whichever of
/// the two is null.
void add(ado::Recordset& row, const QString& column, const QVariant& amount);
void subtract(ado::Recordset& row, const QString& column, const QVariant& amount);

/// A null in that column of the current row becomes 0.
void nullBecomesZero(ado::Recordset& row, const QString& column);

}  // namespace data
