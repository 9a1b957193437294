// SPDX-License-Identifier: MIT
#pragma once

#include <optional>

#include "platform/ado/Session.h"
#include "platform/ado/Statement.h"

namespace ado {

/// What the translator asks about the book.
class Schema {
public:
    virtual ~Schema() = default;
    /// True for an existing table whose rows have an identity; false for a view.
    virtual bool isTable(QStringView name) = 0;
    /// The declared type of a column of a table or view; nothing when there is no such column.
    virtual std::optional<ColumnType> columnType(QStringView table, QStringView column) = 0;
};

/// Name of the collation by which texts sort as a Portuguese reader expects.
inline constexpr auto Collation = "portuguese";
/// Name of SQLite's row identity.
inline constexpr auto Identity = "_rowid_";

/// The statement in SQLite's dialect. With `withIdentity` (only for a `SELECT *` over one table)
/// the row identity stands before the columns. What no rule knows is passed on as it stands.
QString translate(const Statement& statement, Schema& schema, bool withIdentity);

}  // namespace ado
