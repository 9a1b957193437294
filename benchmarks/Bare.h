// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <memory>
#include <variant>
#include <vector>

#include "benchmarks/Books.h"

namespace benchmarks {

/// Texts must live as long as the call.
using BareValue = std::variant<qint64, double, const char*>;

/// Rows of a query, one after the other.
class BareRows {
public:
    virtual ~BareRows() = default;
    virtual bool next() = 0;
    virtual qint64 integer(int column) const = 0;
    virtual double real(int column) const = 0;
    virtual const char* text(int column) const = 0;
};

/// An engine's client library without anything around it, as somebody would write it who wants to
/// be faster: everything stays prepared, and nothing is converted that nobody asked for.
class Bare {
public:
    virtual ~Bare() = default;

    using Values = std::vector<BareValue>;
    /// Runs a query or write, which stays prepared; its values are $1 and so on, in this order.
    /// Reads `column` of its first row; a write is committed.
    virtual double run(const QByteArray& query, const Values& values = {}, int column = 0) = 0;
    /// A pass over a query, on a connection of its own.
    virtual std::unique_ptr<BareRows> rows(const QByteArray& query) = 0;

    /// What goes along with a query or write on a row, in the same round trip.
    enum class Lock { Hold, LetGo, Both };
    /// The same beside a row that is held against other workstations. On SQLite nothing is held,
    /// which costs no query.
    virtual double runLocked(const QByteArray& /*row*/, Lock /*lock*/, const QByteArray& query,
                             const Values& values = {}) {
        return run(query, values);
    }
};

std::unique_ptr<Bare> bareSqlite(const Book& book);
std::unique_ptr<Bare> barePostgres(const Book& book);
inline std::unique_ptr<Bare> bare(const Book& book) {
    return book.engine == Engine::Sqlite ? bareSqlite(book) : barePostgres(book);
}

}  // namespace benchmarks
