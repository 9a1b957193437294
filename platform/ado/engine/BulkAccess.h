// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <functional>
#include <map>
#include <set>
#include <variant>
#include <vector>

#include "platform/ado/engine/Column.h"
#include "platform/core/Money.h"

namespace ado {

/// One value of a row: null, a whole number, a number, an amount, or UTF-8 text.
using BulkValue = std::variant<std::monostate, qint64, double, core::Money, QByteArray>;
using BulkRow = std::vector<BulkValue>;

/// A table as a book has it; names as the engine spells them.
struct TableShape {
    QByteArray name;
    std::vector<QByteArray> columns;
    std::vector<ColumnType> types;  ///< what each column holds

    /// The first so many columns as a list for a statement.
    QByteArray columnList(std::size_t count) const;
    QByteArray columnList() const { return columnList(columns.size()); }
    /// The UPDATE of the row whose first column holds the first value; values are marked "?1", "?2"
    /// and so on where the mark is "?".
    QByteArray changeStatement(const char* mark) const;
    [[noreturn]] void failForMissingRow() const;
};

/// The tables of a book by their names, without regard to case.
class TableShapes {
public:
    explicit TableShapes(std::vector<TableShape> shapes);
    /// Null when the book has no such table.
    const TableShape* find(const QByteArray& name) const;
    /// Fails when the book has no such table.
    const TableShape& at(const QByteArray& name) const;

private:
    struct Before {
        bool operator()(const QByteArray& one, const QByteArray& other) const {
            return one.compare(other, Qt::CaseInsensitive) < 0;
        }
    };
    std::map<QByteArray, TableShape, Before> shapes_;
};

/// What a table comes to, by which two books are compared.
struct Totals {
    qint64 rows = 0;
    std::vector<qint64> sums;  ///< of each column of amounts, in ten-thousandths; exact

    bool operator==(const Totals&) const = default;
};

/// A book as those need it who set one up, fill it or copy it whole: statements without limit, and
/// rows by the million. Failures are core::Failure with the engine's text.
class BulkAccess {
public:
    /// Filling is for a book that nobody uses yet; Changing for one with rows in it, which others
    /// may go on reading meanwhile; Importing for some tables, beside which others go on working,
    /// by a user who may write those alone.
    enum class Purpose { Reading, Filling, Changing, Importing };

    virtual ~BulkAccess() = default;

    /// Runs statements that give no rows (or whose rows nobody wants), separated by ';'.
    virtual void execute(const QByteArray& statements) = 0;
    /// The first column of the first row as a whole number; 0 when there is none, 1 for true.
    virtual qint64 number(const QByteArray& query) = 0;
    /// The first column of all rows as texts; an empty one for null.
    virtual QStringList texts(const QByteArray& query) = 0;
    /// The book's schema in the engine's own words. It is written in those of SQLite.
    virtual QByteArray translated(const QByteArray& schema) const = 0;

    /// Begins a transaction, which is undone unless commit() is reached. Whoever reads sees the
    /// book as it stands now, whatever others write meanwhile; while somebody fills or changes a
    /// book, nobody else writes to it; while somebody imports, nobody else does.
    virtual void begin(Purpose purpose) = 0;
    virtual void commit() = 0;

    /// All tables, without what an engine adds for itself.
    virtual std::vector<TableShape> tables() = 0;
    /// Calls for each row in the order of insertion, its values beside the shape's columns. Memory
    /// does not grow with the rows.
    virtual void eachRow(const TableShape& shape,
                         const std::function<void(const BulkRow&)>& row) = 0;
    /// What the book consists of: its tables, views and indexes that have a name of their own, in
    /// lower case.
    virtual std::set<QByteArray> parts() = 0;
    virtual Totals totals(const TableShape& shape) = 0;
    /// The last key given, of each table that generates its keys; names in lower case.
    virtual std::map<QByteArray, qint64> lastKeys() = 0;

    /// Adds a row, its values beside the table's first columns; the others take their defaults. All
    /// rows of a shape have as many values, and it must live until flush().
    virtual void add(const TableShape& shape, const BulkRow& row) = 0;
    /// Writes a row's values beside the shape's columns, of which the first is the table's key.
    /// Fails when there is no row of that key. The shape must live until flush().
    virtual void change(const TableShape& shape, const BulkRow& row) = 0;
    /// Removes all rows of a table.
    virtual void clear(const TableShape& shape) = 0;
    /// From here on every row that was added can be read.
    virtual void flush() = 0;
    /// The keys that the table generates go on behind this one. The rows must have been flushed.
    virtual void continueAfter(const TableShape& shape, qint64 lastKey) = 0;
};

}  // namespace ado
