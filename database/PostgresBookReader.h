// SPDX-License-Identifier: MIT
#pragma once

#include "database/BookReader.h"
#include "database/Postgres.h"

namespace database {

class PostgresBookReader : public BookReader {
public:
    explicit PostgresBookReader(postgres::Database& book) : book_(book) {}

    std::vector<TableShape> tables() override;
    void eachRow(const TableShape& shape, const Row& row) override;
    Totals totals(const TableShape& shape) override;
    std::map<QByteArray, qint64> lastKeys() override;

private:
    postgres::Database& book_;
    std::map<QByteArray, QByteArray> order_;  ///< the column by which a table's rows were added
};

}  // namespace database
