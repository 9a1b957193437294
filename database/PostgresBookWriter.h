// SPDX-License-Identifier: MIT
#pragma once

#include <unordered_map>

#include "database/BookWriter.h"
#include "database/Postgres.h"

namespace database {

/// Fills a book on a server, within a transaction of the caller's.
class PostgresBookWriter : public BookWriter {
public:
    explicit PostgresBookWriter(postgres::Database& book) : book_(book) {}

    void add(const Table& table, const std::vector<Value>& values) override;
    void clear(const Table& table) override;
    void flush() override;
    void continueAfter(const Table& table, qint64 lastKey) override;
    /// To be called last: flushes, lets generated keys go on behind the highest ones that were
    /// added, and has the server look at what it holds, so that the first statements are quick.
    void finish();

private:
    void flush(const Table& table, QByteArray& lines);

    postgres::Database& book_;
    std::unordered_map<const Table*, QByteArray> pending_;  ///< lines that the server waits for
};

}  // namespace database
