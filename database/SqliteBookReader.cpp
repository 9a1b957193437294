// SPDX-License-Identifier: MIT
#include "database/SqliteBookReader.h"

#include <sqlite3.h>

#include "platform/ado/sqlite/Types.h"

namespace database {

using ado::ColumnType;

namespace {

QByteArray textAt(const sqlite::Statement& row, int column) {
    const void* bytes = sqlite3_column_blob(row.handle(), column);
    return {static_cast<const char*>(bytes), sqlite3_column_bytes(row.handle(), column)};
}

/// What stands in a column, whatever it was declared to hold: the engine keeps anything anywhere,
/// and it is for the other side to refuse what does not fit.
Value valueAt(const sqlite::Statement& row, int column, ColumnType type) {
    sqlite3_stmt* handle = row.handle();
    switch (sqlite3_column_type(handle, column)) {
        case SQLITE_NULL:
            return Null;
        case SQLITE_INTEGER:
            if (type != ColumnType::Money) return qint64{sqlite3_column_int64(handle, column)};
            [[fallthrough]];
        case SQLITE_FLOAT: {
            const double number = sqlite3_column_double(handle, column);
            if (type == ColumnType::Money) return core::Money::fromDouble(number);
            return number;
        }
        default:
            return textAt(row, column);
    }
}

}  // namespace

std::vector<TableShape> SqliteBookReader::tables() {
    std::vector<TableShape> shapes;
    sqlite::Statement columns(book_,
                              "SELECT t.name, c.name, c.type FROM sqlite_master t, "
                              "pragma_table_info(t.name) c WHERE t.type = 'table' AND "
                              "t.name NOT LIKE 'sqlite\\_%' ESCAPE '\\' ORDER BY t.name, c.cid");
    while (columns.step()) {
        const QByteArray table = textAt(columns, 0);
        if (shapes.empty() || shapes.back().table.name != table)
            shapes.push_back({{table, {}}, {}});
        shapes.back().table.columns.push_back(textAt(columns, 1));
        shapes.back().types.push_back(ado::sqlite::typeOfDeclaration(textAt(columns, 2)));
    }
    return shapes;
}

void SqliteBookReader::eachRow(const TableShape& shape, const Row& row) {
    sqlite::Statement rows(book_, "SELECT " + shape.table.columnList() + " FROM " +
                                      shape.table.name + " ORDER BY _rowid_");
    std::vector<Value> values(shape.types.size());
    while (rows.step()) {
        for (size_t at = 0; at < values.size(); ++at)
            values[at] = valueAt(rows, static_cast<int>(at), shape.types[at]);
        row(values);
    }
}

Totals SqliteBookReader::totals(const TableShape& shape) {
    QByteArray text = "SELECT count(*)";
    for (size_t at = 0; at < shape.types.size(); ++at)
        if (shape.types[at] == ColumnType::Money)
            text += ", sum(CAST(round(" + shape.table.columns[at] + " * 10000) AS INTEGER))";
    sqlite::Statement sums(book_, text + " FROM " + shape.table.name);
    sums.step();
    Totals totals{sqlite3_column_int64(sums.handle(), 0), {}};
    for (int at = 1; at < sqlite3_column_count(sums.handle()); ++at)
        totals.sums.push_back(sqlite3_column_int64(sums.handle(), at));
    return totals;
}

std::map<QByteArray, qint64> SqliteBookReader::lastKeys() {
    std::map<QByteArray, qint64> keys;
    sqlite::Statement generated(book_,
                                "SELECT t.name, coalesce(s.seq, 0) FROM sqlite_master t LEFT JOIN "
                                "sqlite_sequence s ON s.name = t.name WHERE t.type = 'table' AND "
                                "t.sql LIKE '%AUTOINCREMENT%'");
    while (generated.step())
        keys[textAt(generated, 0).toLower()] = sqlite3_column_int64(generated.handle(), 1);
    return keys;
}

}  // namespace database
