// SPDX-License-Identifier: MIT
#pragma once

#include "database/BookReader.h"
#include "database/Sqlite.h"

namespace database {

class SqliteBookReader : public BookReader {
public:
    explicit SqliteBookReader(sqlite::Database& book) : book_(book) {}

    std::vector<TableShape> tables() override;
    void eachRow(const TableShape& shape, const Row& row) override;
    Totals totals(const TableShape& shape) override;
    std::map<QByteArray, qint64> lastKeys() override;

private:
    sqlite::Database& book_;
};

}  // namespace database
