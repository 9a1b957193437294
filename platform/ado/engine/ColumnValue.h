// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>

#include "platform/ado/engine/Cell.h"
#include "platform/ado/engine/Session.h"

namespace ado {

/// The value of a cell of that column, as the screens and rules know it. A cell that does not fit
/// its column's type (a foreign program wrote it) comes as what it is.
QVariant toVariant(const Cell& cell, ColumnType type);

/// What the column keeps of a value that is written to it. Numbers in texts are read with a decimal
/// point, dates in texts as ISO or as month/day/year. Fails with TypeMismatch, or with Overflow
/// when the value is past the column's range or length.
QVariant toColumn(const QVariant& value, const Column& column);

/// A date and time as it is stored and as texts of it are compared: "YYYY-MM-DD HH:MM:SS".
QString storedForm(const QDateTime& moment);

/// Reads a date text of a query or of a person's hand: "YYYY-MM-DD" or month/day/year, behind
/// it maybe "HH:MM[:SS]". Invalid when there is no such moment.
QDateTime parseMoment(QStringView text);

}  // namespace ado
