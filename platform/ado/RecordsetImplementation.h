// SPDX-License-Identifier: MIT
#pragma once

#include <QHash>
#include <algorithm>
#include <optional>
#include <unordered_map>

#include "platform/ado/Recordset.h"
#include "platform/ado/Rows.h"
#include "platform/ado/dialect/ShapeQuery.h"

namespace ado {

/// Values of a row by column, few of them.
class Changes {
public:
    bool isEmpty() const { return values_.empty(); }
    void clear() { values_.clear(); }
    const QVariant* find(int column) const {
        for (const auto& value : values_)
            if (value.first == column) return &value.second;
        return nullptr;
    }
    void set(int column, const QVariant& value) {
        for (auto& known : values_)
            if (known.first == column) {
                known.second = value;
                return;
            }
        values_.emplace_back(column, value);
    }
    const std::vector<std::pair<int, QVariant>>& values() const { return values_; }

private:
    std::vector<std::pair<int, QVariant>> values_;
};

/// Child rows of a SHAPE, by the value that relates them.
struct ChapterRows {
    QString name;
    int parentColumn = -1;
    std::shared_ptr<Pass> description;
    QHash<QString, std::shared_ptr<RowStore>> byKey;
};

/// What is current. An added row is one that this set inserted; it is read back when looked at.
enum class At { Nothing, Row, Added, New };

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

    At at = At::Nothing;
    At before = At::Nothing;  ///< what was current when a new row was started
    qint64 addedAt = 0;
    std::vector<RowIdentity> added;
    Changes changes;  ///< written to the current row and not stored yet
    RowStore fresh;   ///< the current row, read afresh from the table
    bool wantsFresh = false;
    std::unique_ptr<RowLock> held;
    bool wasHeld = false;  ///< `fresh` was read under a lock, which may be gone by now
    std::unique_ptr<RowLock> heldPlace;  ///< of the first row of a table that has none
    bool settled =
        false;  ///< the current row was stored; until it is changed again nobody holds it
    bool deleted = false;                        ///< the current row was deleted here
    std::unordered_map<qint64, Changes> stored;  ///< by row in memory: what this set stored there
    std::vector<bool> storedFar;                 ///< rows of a long set that this set stored
    std::vector<qint64> gone;                    ///< rows that this set deleted, ascending

    struct Name {
        QString text;
        int column = -1;
    };
    mutable Name names[64];  ///< names found lately, by the place of their text
    std::vector<std::optional<ColumnType>> types;  ///< of the columns that were read

    // Opening.
    void openRows();
    void openStatement(const Query& statement);
    void openShape(const Query& statement);
    void close();

    // Moving.
    void leaveRow();
    void toFirst();
    void toNext();
    void toLast();
    void toRow(qint64 row);
    /// Settles on a row of the statement, or passes it when it is gone.
    void arrive(bool found);
    bool isStoredFar(qint64 row) const {
        const auto place = static_cast<std::size_t>(row);
        return place < storedFar.size() && storedFar[place];
    }
    /// True for a row of the statement that may be another by now.
    bool isOutdated(qint64 row) const {
        return (cursor == adOpenDynamic && !table.isEmpty()) || isStoredFar(row);
    }
    void noteStored();
    bool isGone(qint64 row) const { return std::binary_search(gone.begin(), gone.end(), row); }
    qint64 recordCount() const;
    qint64 rowsInMemory() const;
    /// The statement's row that a list shows at that place.
    qint64 shown(qint64 place) const;

    // Reading.
    int find(const QString& name) const;
    int columnOf(const QString& name) const;
    QVariant value(int column);
    QVariant valueAt(qint64 place, int column);
    RowIdentity identity();
    /// Takes the lock that the current row needs and reads the row afresh where that is called for.
    void look() {
        if (!table.isEmpty()) lookAtRow();
    }
    void lookAtRow();
    bool isHeld() const { return held && held->isUnbroken(); }
    /// Takes a lock again that went with its connection; fails with RowInUse when the row is not
    /// any more as it was read.
    void holdStill();
    ColumnType typeOf(int column);
    bool readFresh();

    // Writing.
    void requireOpen() const {
        if (!rows) refuseClosed();
    }
    void requireRow() const {
        requireOpen();
        if (at == At::Nothing || deleted) refuseNoRow();
    }
    [[noreturn]] static void refuseClosed();
    [[noreturn]] static void refuseNoRow();
    void requireTable() const;
    bool readOnly() const { return lockType == adLockUnspecified || lockType == adLockReadOnly; }
    /// The session to write through; fails when the rows came from another book.
    std::shared_ptr<Session> session() const;
    bool setValue(int column, const QVariant& value);
    void addNew();
    void update(const Accompaniment& with);
    void insertNew(const Accompaniment& with);
    void updateCurrent(const Accompaniment& with);
    void cancel();
    void remove();
};

}  // namespace ado
