// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <unordered_map>

#include "database/BookWriter.h"
#include "database/Sqlite.h"

namespace database {

/// Fills an SQLite book within one transaction, which is undone unless commit() is reached. While
/// it lives nobody else can use the book.
class SqliteBookWriter : public BookWriter {
public:
    explicit SqliteBookWriter(sqlite::Database& book);
    ~SqliteBookWriter() override;
    SqliteBookWriter(const SqliteBookWriter&) = delete;
    SqliteBookWriter& operator=(const SqliteBookWriter&) = delete;

    void add(const Table& table, const std::vector<Value>& values) override;
    void clear(const Table& table) override;
    void flush() override {}
    void continueAfter(const Table& table, qint64 lastKey) override;
    void commit();

private:
    sqlite::Statement& statement(const Table& table);
    void leave();

    sqlite::Database& book_;
    std::unordered_map<const Table*, std::unique_ptr<sqlite::Statement>> statements_;
};

}  // namespace database
