// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>
#include <string_view>

#include "platform/ado/engine/Session.h"
#include "platform/ado/postgres/Handle.h"

namespace ado::postgres {

/// What the server's types stand for: numeric(p,4) is an amount; a numeric of any other form, which
/// is what a calculation gives, comes as a 64-bit float. `modifier` is the type's own (a length, a
/// precision), -1 for none.
ColumnType typeOf(Oid type, int modifier);
/// A column of an answer.
Column describe(const PGresult* result, int column);

/// A value in the server's text form that is not null; good as long as the text lives.
Cell cellOf(std::string_view text, ColumnType type);
/// A value of an answer, good as long as the answer lives.
Cell cellOf(const PGresult* result, int row, int column, ColumnType type);
Cell cellOf(const PGresult* result, int row, int column);

/// The server's text of a value that was converted to its column's type; nothing for null.
std::optional<QByteArray> parameterOf(const QVariant& value);

}  // namespace ado::postgres
