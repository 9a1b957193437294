// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>
#include <memory>
#include <vector>

#include "platform/ado/Recordset.h"

/// What an engine offers to the row sets. One session is one open connection of one engine; all
/// statement texts that come here are translated already. Failures are core::Failure with the
/// engine's text.
namespace ado {

/// A column of a result as the engine describes it.
struct Column {
    QString name;
    ColumnType type = ColumnType::Other;
    int definedSize = 0;
};

/// Which row of a table: the engine's own identity of it (SQLite's rowid, a generated column on
/// PostgreSQL). Distinct for rows that are equal in every column.
using RowIdentity = qint64;

/// A forward pass over the rows of one statement. The rows are those of the moment of opening.
class Pass {
public:
    virtual ~Pass() = default;
    virtual const std::vector<Column>& columns() const = 0;
    /// Steps to the next (at first: the first) row; false when there is none.
    virtual bool step() = 0;
    /// A value of the row stepped to; converted when asked for.
    virtual QVariant value(int column) const = 0;
    /// Identity of the row stepped to; only for a pass opened with a table.
    virtual RowIdentity identity() const = 0;
};

/// A row held against everybody else; let go when destroyed, and by a crash.
class RowLock {
public:
    virtual ~RowLock() = default;
};

class Session {
public:
    virtual ~Session() = default;

    /// The dialect of this engine for a statement of the original dialect.
    virtual QString translate(const QString& statement) const = 0;

    /// Opens a pass. With `table` not empty the statement is a `SELECT *` over that one table and
    /// the pass knows each row's identity.
    virtual std::unique_ptr<Pass> open(const QString& translated, const QString& table) = 0;

    /// True when rows of that name can be written: an existing table, not a view.
    virtual bool isTable(const QString& name) = 0;

    /// Reads one row of a table afresh, in the order of the table's columns; empty when it is gone.
    virtual std::vector<QVariant> read(const QString& table, RowIdentity row) = 0;

    // One statement, one commit each. `columns` names what is written, `values` runs beside it.
    virtual RowIdentity insert(const QString& table, const QStringList& columns,
                               const std::vector<QVariant>& values) = 0;
    /// False when the row is gone.
    virtual bool update(const QString& table, RowIdentity row, const QStringList& columns,
                        const std::vector<QVariant>& values) = 0;
    virtual bool remove(const QString& table, RowIdentity row) = 0;

    /// Holds a row, waiting at most `timeoutSeconds`; fails with RowInUse and a text that says who
    /// holds it.
    virtual std::unique_ptr<RowLock> lock(const QString& table, RowIdentity row,
                                          int timeoutSeconds) = 0;

    /// Seconds that a statement may wait for another program before it fails.
    virtual void setTimeout(int seconds) = 0;
};

}  // namespace ado
