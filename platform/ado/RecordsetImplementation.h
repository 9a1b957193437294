// SPDX-License-Identifier: MIT
#pragma once

#include <QHash>

#include "platform/ado/CurrentRow.h"
#include "platform/ado/OwnWrites.h"
#include "platform/ado/Recordset.h"
#include "platform/ado/Rows.h"
#include "platform/ado/dialect/ShapeQuery.h"

namespace ado {

class RowFile;

/// Child rows of a SHAPE, by the value that relates them.
struct ChapterRows {
    QString name;
    int parentColumn = -1;
    std::shared_ptr<Pass> description;
    QHash<QString, std::shared_ptr<RowStore>> byKey;
    std::size_t bytes = 0;          ///< of all children that are in memory
    std::shared_ptr<RowFile> file;  ///< where the others are; none while there are none

    /// Keeps the child row that the pass stands on, if it has a parent.
    void keep(const QString& key);
};

/// State and work of a row set; Recordset adds the signals.
struct Recordset::Implementation {
    ConnectionPtr connection;
    QString source;
    CursorType cursor = adOpenUnspecified;
    LockType lockType = adLockUnspecified;
    bool clientSide = false;

    std::unique_ptr<Rows> rows;  ///< none while the set is closed
    QString table;               ///< the table whose rows are written; empty for none
    QString book;                ///< where the rows came from; empty for the rows of a chapter
    std::shared_ptr<ChapterRows> chapter;

    CurrentRow current;
    OwnWrites own;
    std::unique_ptr<RowLock> heldPlace;  ///< of the first row of a table that has none

    struct Name {
        QString text;
        int column = -1;
    };
    mutable Name names[64];           ///< names found lately, by the place of their text
    std::vector<int> writtenColumns;  ///< of the last write
    QStringList writtenNames;

    // Opening.
    void openRows();
    void openQuery(const Query& query);
    void openShape(const Query& query);
    void close();

    // Moving.
    void toFirst();
    void toNext();
    void toLast();
    void toRow(qint64 place);
    /// Stands on a row of the query, or passes it when it is gone.
    void arrive(bool found);
    void standOnInserted(qint64 which) {
        current.standOn(which < own.insertedCount() ? At::Inserted : At::Nothing, true, which);
    }
    /// While writes are gathered nobody else is looked for.
    bool isDynamic() const { return cursor == adOpenDynamic && !table.isEmpty() && !isGathering(); }
    bool isGathering() const {
        return connection && connection->State() == adStateOpen &&
               connection->session()->isGathering();
    }
    /// True for a row of the query that may be another by now.
    bool isOutdated(qint64 row) const { return isDynamic() || own.isMarked(row); }
    bool isOutdated() const { return current.at() != At::Queried || isOutdated(rows->row()); }
    qint64 recordCount() const {
        if (cursor == adOpenStatic || cursor == adOpenKeyset) rows->countAll();
        return rows->count() < 0 ? -1 : own.shownOf(rows->count());
    }
    qint64 rowsInMemory() const { return rows && rows->inMemory() ? recordCount() : 0; }

    // Reading.
    int find(const QString& name) const;
    int columnOf(const QString& name) const;
    QVariant value(int column);
    QVariant valueAt(qint64 place, int column);
    TableRow tableRow();
    /// Takes the lock that the current row needs and reads the row afresh where that is called for.
    void look() {
        const bool pessimistic = lockType == adLockPessimistic;
        if (!table.isEmpty() && current.needsLook(pessimistic))
            current.look(tableRow(), pessimistic);
    }
    /// Takes a lock again that went with its connection.
    void holdStill() {
        if (current.isHoldBroken()) current.holdAgain(tableRow());
    }

    // Writing.
    void requireOpen() const {
        if (!rows) refuseClosed();
    }
    void requireRow() const {
        requireOpen();
        if (!current.exists()) refuseNoRow();
    }
    [[noreturn]] static void refuseClosed();
    [[noreturn]] static void refuseNoRow();
    void requireTable() const;
    bool readOnly() const { return lockType == adLockUnspecified || lockType == adLockReadOnly; }
    /// The session to write through; fails when the rows came from another book.
    std::shared_ptr<Session> session() const;
    bool setValue(int column, const QVariant& value);
    /// False when the value has to be converted, or is not simply what a query read.
    bool copyCell(int column, const Implementation& from, int fromColumn);
    void addNew();
    void update(const Accompaniment& with);
    /// The changes: the names of their columns, which rows that are added one after the other have
    /// in common, and the values beside them.
    std::pair<QStringList, std::vector<QVariant>> written();
    void insertNew(const Accompaniment& with);
    void updateCurrent(const Accompaniment& with);
    void remove();
};

}  // namespace ado
