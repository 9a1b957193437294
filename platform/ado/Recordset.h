// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QVariant>
#include <memory>
#include <vector>

#include "platform/ado/Connection.h"
#include "platform/ado/Constants.h"
#include "platform/ado/engine/Accompanying.h"
#include "platform/ado/engine/Cell.h"
#include "platform/ado/engine/Column.h"

namespace ado {

class Recordset;
using RecordsetPtr = std::shared_ptr<Recordset>;

/// One column of a row set; a light view that stays valid while the row set stays open.
class Field {
public:
    QString Name() const;
    /// Characters that a text column keeps (0 without a limit); bytes for other types.
    int DefinedSize() const;
    ColumnType Type() const;
    /// The value of the current row. Null is an invalid QVariant.
    QVariant Value() const;
    /// See Recordset::setCollect.
    void setValue(const QVariant& value);

private:
    friend class Recordset;
    Field(Recordset* owner, int column) : owner_(owner), column_(column) {}
    Recordset* owner_;
    int column_;
};

/// Rows of one query, one of them current. Opening costs what is read, not what the table
/// holds; a pass over a large table runs in bounded memory. Rows of a `SELECT *` over one table can
/// be written with a lock type other than read only.
///
/// Every failure is a core::Failure with the engine's own text.
class Recordset : public QObject {
    Q_OBJECT
public:
    static RecordsetPtr create();
    /// An open set of values that were never in a book, to be read only: for reports of what a
    /// program worked out. Each row has a value of the column's type for each column; an invalid
    /// one is null.
    static RecordsetPtr ofValues(std::vector<Column> columns, std::vector<QVariantList> rows);
    ~Recordset() override;

    /// Opens a query: one SELECT, or a SHAPE on a shaping connection; anything else, or a
    /// second query behind it, is refused before it reaches the engine. The first row, if any,
    /// is current. A dynamic pessimistic set of a table without rows holds the place of the first
    /// one until Update or Close, so that of several workstations one alone adds a counter's row.
    void Open(const QString& source, const ConnectionPtr& connection,
              CursorType cursor = adOpenUnspecified, LockType lock = adLockUnspecified,
              CommandType options = adCmdUnspecified);
    ObjectState State() const;
    /// Drops rows, a pending row and any lock.
    void Close();
    /// Runs the same text again.
    void Requery();
    const QString& Source() const;

    /// True when no row is current because the set is empty or was passed through.
    bool atEnd() const;
    void MoveFirst();
    void MoveLast();
    void MoveNext();
    /// Rows of the set; -1 of a long one without a static or keyset cursor as long as nobody has
    /// come to its end, as MoveLast does.
    qint64 RecordCount() const;

    /// Starts a new row and makes it current. Columns not written read as null and take the
    /// table's own defaults at Update. A row pending from before is dropped.
    void AddNew();
    /// Writes the changed columns of the current row, or the new row, whose generated key and
    /// defaults can be read afterwards. Without a change it does nothing. The lock of the row goes.
    /// @param with  written in the same commit, also when the row itself has no change; fails with
    /// NotAccompanied, and writes nothing, where it does not find its row
    void Update(const Accompaniment& with = {});
    /// Drops what was written to the current row since it became current, or the pending new row.
    void CancelUpdate();
    void Delete();
    /// True from AddNew until Update, CancelUpdate or a move.
    bool isNewRow() const;

    /// A column by name (without regard to case). Fails with NoSuchItem and the name.
    Field Fields(const QString& name);
    Field Fields(int column);
    int columnCount() const;
    /// Place of a column, for passes over very many rows. Fails as Fields does.
    int columnOf(const QString& name) const;
    /// True when the set has a column of that name.
    bool hasColumn(const QString& name) const;

    QVariant Collect(const QString& name) const;
    /// The value is converted to the column's type at once, so that reading it back gives what the
    /// column keeps. Fails with TypeMismatch, Overflow (past the column's range or length),
    /// NotUpdatable (read-only set) or NoCurrentRow.
    void setCollect(const QString& name, const QVariant& value);
    /// The value as the query read it, for a mere lookup: the row is not held for it and nobody
    /// is waited for. Of a row that this set added, null.
    QVariant readValue(const QString& name) const;
    /// The same as the engine keeps it, good until the next move: for passes over very many rows,
    /// of which nothing is converted that nobody wants.
    Cell readCell(int column) const;
    QVariant value(int column) const;
    void setValue(int column, const QVariant& value);
    /// The same as setValue(column, from.value(fromColumn)). Where a new row gets the values of
    /// another query of the book, nothing is converted on the way, and fieldChanged is not told.
    void copyValue(int column, const Recordset& from, int fromColumn);

    /// The child set of the current row of a SHAPE query, by the name of its chapter. Of a set
    /// without rows it is an empty one that knows its columns.
    RecordsetPtr Chapter(const QString& name) const;

    // For lists, which show many rows without moving the current one. Only sets that are held in
    // memory (those of commands, and small ones) have them; others are taken in by readAll().
    void readAll();
    qint64 rowsInMemory() const;
    QVariant valueAt(qint64 row, int column) const;
    /// Makes a row in memory the current one.
    void MoveTo(qint64 row);

    /// Holds all rows in memory from the next Open on and lets go of the engine at once, as the
    /// named commands are designed.
    void setClientSide(bool clientSide);

signals:
    /// The rows were opened or requeried; lists take them anew.
    void opened();
    /// Another row is current (also none), or the current one was written or read afresh.
    void currentRowChanged();
    /// A value of the current row was set.
    void fieldChanged(int column);
    void closed();

private:
    Recordset();
    friend class Field;
    struct Implementation;
    std::unique_ptr<Implementation> d;
};

}  // namespace ado
