// SPDX-License-Identifier: MIT
#pragma once

#include <sqlite3.h>

#include <QVariant>

#include "platform/ado/engine/Session.h"

namespace ado::sqlite {

/// What a declared type stands for: MONEY, REAL (32-bit), DOUBLE, INTEGER, SMALLINT, BIGINT,
/// DATETIME, VARCHAR(n), TEXT. Without a declared type a column is Other: its values come as the
/// engine keeps them.
ColumnType typeOfDeclaration(const char* declared);
/// A described column; `declared` may be null.
Column describe(const char* name, const char* declared);

/// A value of the row that the statement stands on, good until its next step.
Cell cellOf(sqlite3_stmt* statement, int column);

/// Binds a value that was converted to its column's type. Amounts that a binary number does not
/// hold to the fourth decimal fail with Overflow.
void bind(sqlite3_stmt* statement, int parameter, const QVariant& value);
void bind(sqlite3_stmt* statement, int parameter, const Cell& value);

}  // namespace ado::sqlite
