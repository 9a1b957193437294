// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <QVariant>
#include <memory>
#include <vector>

#include "platform/ado/engine/Accompanying.h"
#include "platform/ado/engine/Cell.h"
#include "platform/ado/engine/Column.h"

/// What an engine offers to the row sets. One session is one open connection of one engine.
/// Failures are core::Failure with the engine's text.
namespace ado {

class Query;
class RowStore;

/// A forward pass over the rows of one query. The rows are those of the moment of opening.
class Pass {
public:
    virtual ~Pass() = default;

    // The columns are described when asked for, and also after release().
    virtual int columnCount() const = 0;
    virtual const Column& column(int column) const = 0;
    /// Position of a column, its name compared without regard to case; -1 when there is none.
    virtual int indexOf(QStringView name) const = 0;

    /// Steps to the next (at first: the first) row; false when there is none. After that only
    /// restart() and release() are left.
    virtual bool step() = 0;
    /// A value of the row stepped to, good until the next step.
    virtual Cell cell(int column) const = 0;
    /// Identity of the row stepped to; 0 for a pass that was not opened with a table.
    virtual RowIdentity identity() const = 0;
    /// Stands before the first row again; the rows are the same, whatever was written since.
    virtual void restart() = 0;
    /// How many rows it gives, from the first to the last. After that only restart() and release()
    /// are left.
    virtual qint64 rowsInAll() = 0;
    /// Lets go of the engine; no row can be stepped to any more.
    virtual void release() = 0;
};

/// A row held against everybody else; let go when destroyed, and by a crash.
class RowLock {
public:
    virtual ~RowLock() = default;
    /// False once the connection that held the row is lost: somebody else may have it by now.
    virtual bool isUnbroken() const { return true; }
};

class Session {
public:
    virtual ~Session() = default;

    /// Opens a pass over a query of the original dialect. With `table` not empty the query
    /// is a `SELECT *` over that one table and the pass knows each row's identity.
    virtual std::shared_ptr<Pass> open(const Query& query, const QString& table) = 0;

    /// True when rows of that name can be written: an existing table, not a view.
    virtual bool isTable(QStringView name) = 0;
    /// True when this user has the right to add, change and delete rows of a table.
    virtual bool mayWrite(const QString& /*table*/) { return true; }

    /// Reads one row of a table afresh and appends it, in the order of the table's columns; false
    /// when it is gone.
    virtual bool read(const QString& table, RowIdentity row, RowStore& into) = 0;

    // One commit each. `columns` names what is written, `values` runs beside it. A row whose lock
    // was lost with its connection is not written: RowInUse. Where what accompanies the write does
    // not touch exactly one row, nothing is written: NotAccompanied.
    virtual RowIdentity insert(const QString& table, const QStringList& columns,
                               const std::vector<QVariant>& values, const Accompaniment& with) = 0;
    /// False when the row is gone. Without columns only what accompanies the row is written.
    virtual bool update(const QString& table, RowIdentity row, const QStringList& columns,
                        const std::vector<QVariant>& values, const Accompaniment& with) = 0;
    virtual bool remove(const QString& table, RowIdentity row) = 0;

    /// Holds a row, waiting at most `timeoutSeconds`, and reads it afresh as read() does; fails
    /// with RowInUse and a text that says who holds it.
    virtual std::unique_ptr<RowLock> lock(const QString& table, RowIdentity row, int timeoutSeconds,
                                          RowStore& into) = 0;

    /// From here on writes may be gathered: they reach the disk together, in their order, so that
    /// what stands after a kill or a power cut is a beginning of them. A write that fails leaves
    /// those before it standing, and may be told by a later one. Whatever is opened or read
    /// through this session meanwhile sees all of them. Not every engine can tell how a row that is
    /// added so is identified: it then has none (NoRow).
    virtual void gather() = 0;
    /// Everything that was gathered is on the disk; the writes from here on are commits of their
    /// own again. Fails with what a gathered write failed with, and gathers no more all the same.
    virtual void settle() = 0;
    virtual bool isGathering() const = 0;

    /// Seconds that a query may wait for another program before it fails.
    virtual void setTimeout(int seconds) = 0;

    /// Names the book, so that a row's identity is never used on another one.
    virtual const QString& book() const = 0;
};

}  // namespace ado
