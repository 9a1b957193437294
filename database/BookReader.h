// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <map>

#include "database/BookWriter.h"
#include "platform/ado/Recordset.h"

namespace database {

/// A table as a book has it, with what its columns hold; names as the engine spells them.
struct TableShape {
    Table table;
    std::vector<ado::ColumnType> types;
};

/// What a table comes to, by which two books are compared.
struct Totals {
    qint64 rows = 0;
    std::vector<qint64> sums;  ///< of each column of amounts, in ten-thousandths; exact

    bool operator==(const Totals&) const = default;
};

/// Reads a whole book, within a transaction of the caller's. One implementation for each engine.
class BookReader {
public:
    virtual ~BookReader() = default;
    /// All tables, without what an engine adds for itself.
    virtual std::vector<TableShape> tables() = 0;
    /// Calls for each row in the order of insertion, its values beside the shape's columns. Memory
    /// does not grow with the rows.
    using Row = std::function<void(const std::vector<Value>&)>;
    virtual void eachRow(const TableShape& shape, const Row& row) = 0;
    virtual Totals totals(const TableShape& shape) = 0;
    /// The last key given, of each table that generates its keys; names in lower case.
    virtual std::map<QByteArray, qint64> lastKeys() = 0;
};

}  // namespace database
