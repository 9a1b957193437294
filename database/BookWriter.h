// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QDate>
#include <optional>
#include <variant>
#include <vector>

#include "platform/core/Money.h"

namespace database {

/// A table and the columns that are written to it or read, in the order in which values come.
struct Table {
    QByteArray name;
    std::vector<QByteArray> columns;

    /// The columns as a list for a statement.
    QByteArray columnList() const;
};

/// One value of a row: null, a whole number, a number, an amount, or UTF-8 text.
using Value = std::variant<std::monostate, qint64, double, core::Money, QByteArray>;

inline constexpr std::monostate Null;

/// A day as a DATETIME column keeps it; null for an invalid one.
Value dayValue(QDate day);
/// Null for an amount that is not there.
inline Value amountValue(const std::optional<core::Money>& amount) {
    return amount ? Value(*amount) : Value(Null);
}

/// Takes the rows of a book, many and quickly. One implementation for each engine.
class BookWriter {
public:
    virtual ~BookWriter() = default;
    /// Adds a row, its values beside the table's columns; columns that are not the
    /// table object's take their defaults. The table object must outlive the writer.
    virtual void add(const Table& table, const std::vector<Value>& values) = 0;
    /// Removes all rows of a table.
    virtual void clear(const Table& table) = 0;
    /// From here on every row that was added can be read, through the connection that writes.
    virtual void flush() = 0;
    /// The keys that the table generates go on behind this one. The rows must have been flushed.
    virtual void continueAfter(const Table& table, qint64 lastKey) = 0;
};

}  // namespace database
