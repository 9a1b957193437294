// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace ado {

/// What a column keeps.
enum class ColumnType {
    Integer16,
    Integer32,
    Integer64,
    Single,
    Double,
    Money,
    DateTime,
    Text,
    Other
};

/// A column of a result as the engine describes it.
struct Column {
    QString name;
    ColumnType type = ColumnType::Other;
    int definedSize = 0;  ///< characters of a text (0 without a limit); bytes of other types
};

/// Which row of a table: the engine's own identity of it (SQLite's rowid, a generated column on
/// PostgreSQL). Distinct for rows that are equal in every column.
using RowIdentity = qint64;

/// The identity of no row: no engine gives it to one.
inline constexpr RowIdentity NoRow = 0;

}  // namespace ado
