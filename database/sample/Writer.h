// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <optional>

#include "platform/ado/engine/BulkAccess.h"

namespace database::sample {

using Value = ado::BulkValue;
using Row = ado::BulkRow;

inline constexpr std::monostate Null;

/// A day as a column of moments keeps it; null for an invalid one.
Value dayValue(QDate day);
/// Null for an amount that is not there.
inline Value amountValue(const std::optional<core::Money>& amount) {
    return amount ? Value(*amount) : Value(Null);
}

/// Adds rows to a book, by the names of its tables. Values stand beside a table's first columns;
/// the others take their defaults.
class Writer {
public:
    explicit Writer(ado::BulkAccess& book) : book_(book), tables_(book.tables()) {}
    /// To be called last.
    void flush() { book_.flush(); }

    void add(const QByteArray& table, const Row& row) { book_.add(tables_.at(table), row); }
    /// The table, or its twin that holds members who have left.
    void add(const QByteArray& table, bool left, const Row& row) {
        add(left ? table + "_Inactivos" : table, row);
    }
    /// The row becomes the table's only one.
    void put(const QByteArray& table, const Row& row) {
        book_.clear(tables_.at(table));
        add(table, row);
    }

private:
    ado::BulkAccess& book_;
    const ado::TableShapes tables_;
};

}  // namespace database::sample
