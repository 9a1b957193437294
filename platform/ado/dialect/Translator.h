// SPDX-License-Identifier: MIT
#pragma once

#include <optional>

#include "platform/ado/dialect/Query.h"
#include "platform/ado/engine/Session.h"

namespace ado {

/// SQLite's collation by which texts sort as a Portuguese reader expects; on PostgreSQL the columns
/// themselves have theirs.
inline constexpr auto Collation = "portuguese";
/// SQLite's row identity.
inline constexpr auto Identity = "_rowid_";
/// The row identity that tables without a key of one number have on PostgreSQL.
inline constexpr auto HiddenIdentity = "_linha";

/// What the translator asks about the book.
class Schema {
public:
    virtual ~Schema() = default;
    /// True for an existing table whose rows have an identity; false for a view.
    virtual bool isTable(QStringView name) = 0;
    /// The declared type of a column of a table or view; nothing when there is no such column.
    virtual std::optional<ColumnType> columnType(QStringView table, QStringView column) = 0;
    /// The column that is a table's row identity; empty for anything but a table.
    virtual QString identity(QStringView table) {
        return isTable(table) ? QString::fromLatin1(Identity) : QString();
    }
};

enum class Dialect { Sqlite, Postgres };

/// The statement in an engine's dialect. With `withIdentity` (only for a `SELECT *` over one table)
/// the row identity stands before the columns. What no rule knows is passed on as it stands.
QString translate(const Query& statement, Schema& schema, bool withIdentity,
                  Dialect dialect = Dialect::Sqlite);

}  // namespace ado
