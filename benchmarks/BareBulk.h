// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <memory>
#include <vector>

#include "benchmarks/Books.h"

namespace benchmarks {

/// A write for each row of a query; its values are these columns of the row, as they came.
struct BareWrite {
    QByteArray text;  ///< values are $1 and so on
    std::vector<int> columns;
};

/// Many rows through an engine's client library alone, as somebody would write it who wants to be
/// faster and may not lose the order of the writes: everything is prepared once, values go from row
/// to write without a look at them, and the disk is waited for at each 50,000 (a file) or once at
/// the end (a server, which keeps the order itself).
class BareBulk {
public:
    virtual ~BareBulk() = default;
    /// The rows are those of the moment; they are read on a connection of their own.
    virtual void each(const QByteArray& query, const std::vector<BareWrite>& writes) = 0;
    /// Reads what a query gives, and looks at each value once.
    /// @return  rows
    virtual qint64 read(const QByteArray& query) = 0;
    /// Everything is on the disk.
    virtual void finish() = 0;
};

std::unique_ptr<BareBulk> bareBulkSqlite(const Book& book);
std::unique_ptr<BareBulk> bareBulkPostgres(const Book& book);
inline std::unique_ptr<BareBulk> bareBulk(const Book& book) {
    return book.engine == Engine::Sqlite ? bareBulkSqlite(book) : bareBulkPostgres(book);
}

}  // namespace benchmarks
