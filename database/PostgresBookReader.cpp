// SPDX-License-Identifier: MIT
#include "database/PostgresBookReader.h"

#include <libpq-fe.h>

#include <charconv>

#include "platform/ado/postgres/Dialect.h"
#include "platform/ado/postgres/Types.h"
#include "platform/core/Failure.h"

namespace database {

using ado::ColumnType;
using namespace Qt::StringLiterals;

namespace {

// One row is a column of a table with its type; the last one tells whether it belongs to the key.
constexpr auto Columns =
    "SELECT c.relname, a.attname, a.atttypid, a.atttypmod, EXISTS ("
    "       SELECT FROM pg_index i"
    "        WHERE i.indrelid = c.oid AND i.indisprimary AND a.attnum = ANY (i.indkey))"
    "  FROM pg_class c JOIN pg_attribute a ON a.attrelid = c.oid"
    " WHERE c.relnamespace = 'public'::regnamespace AND c.relkind = 'r'"
    "   AND a.attnum > 0 AND NOT a.attisdropped"
    " ORDER BY c.relname, a.attnum";

// One row is a table that generates its keys, and the sequence they come from.
constexpr auto Generated =
    "SELECT c.relname, pg_get_serial_sequence(c.oid::regclass::text, a.attname)"
    "  FROM pg_class c JOIN pg_attribute a ON a.attrelid = c.oid"
    " WHERE c.relnamespace = 'public'::regnamespace AND a.attidentity = 'd'";

QByteArray textAt(const PGresult* row, int column) {
    return {PQgetvalue(row, 0, column), PQgetlength(row, 0, column)};
}

/// Read as what it is: 0.1 of 32 bits is another number than 0.1 of 64.
double single(const QByteArray& text) {
    float number = 0;
    std::from_chars(text.begin(), text.end(), number);
    return static_cast<double>(number);
}

Value valueAt(const PGresult* row, int column, ColumnType type) {
    if (PQgetisnull(row, 0, column)) return Null;
    const QByteArray text = textAt(row, column);
    switch (type) {
        case ColumnType::Integer16:
        case ColumnType::Integer32:
        case ColumnType::Integer64:
            return text.toLongLong();
        case ColumnType::Single:
            return single(text);
        case ColumnType::Double:
            return text.toDouble();
        case ColumnType::Money:
            if (const auto money = core::Money::fromPlainText(QString::fromLatin1(text)))
                return *money;
            throw core::Failure(core::Overflow,
                                u"O montante %1 é grande de mais."_s.arg(QLatin1StringView(text)));
        default:
            return text;
    }
}

}  // namespace

std::vector<TableShape> PostgresBookReader::tables() {
    std::vector<TableShape> shapes;
    book_.eachRow(Columns, [&](const PGresult* row) {
        const QByteArray table = textAt(row, 0);
        const QByteArray column = textAt(row, 1);
        if (shapes.empty() || shapes.back().table.name != table)
            shapes.push_back({{table, {}}, {}});
        const bool isHidden = column == ado::postgres::HiddenIdentity;
        if (isHidden || (textAt(row, 4) == "t" && !order_.contains(table))) order_[table] = column;
        if (isHidden) return;
        shapes.back().table.columns.push_back(column);
        shapes.back().types.push_back(
            ado::postgres::typeOf(textAt(row, 2).toUInt(), textAt(row, 3).toInt()));
    });
    return shapes;
}

void PostgresBookReader::eachRow(const TableShape& shape, const Row& row) {
    const QByteArray text = "SELECT " + shape.table.columnList() + " FROM " + shape.table.name +
                            " ORDER BY " + order_.at(shape.table.name);
    std::vector<Value> values(shape.types.size());
    book_.eachRow(text, [&](const PGresult* next) {
        for (size_t at = 0; at < values.size(); ++at)
            values[at] = valueAt(next, static_cast<int>(at), shape.types[at]);
        row(values);
    });
}

Totals PostgresBookReader::totals(const TableShape& shape) {
    QByteArray text = "SELECT count(*)";
    for (size_t at = 0; at < shape.types.size(); ++at)
        if (shape.types[at] == ColumnType::Money)
            text += ", (coalesce(sum(" + shape.table.columns[at] + "), 0) * 10000)::bigint";
    Totals totals;
    book_.eachRow(text + " FROM " + shape.table.name, [&](const PGresult* row) {
        totals.rows = textAt(row, 0).toLongLong();
        for (int at = 1; at < PQnfields(row); ++at)
            totals.sums.push_back(textAt(row, at).toLongLong());
    });
    return totals;
}

std::map<QByteArray, qint64> PostgresBookReader::lastKeys() {
    std::map<QByteArray, QByteArray> sequences;
    book_.eachRow(Generated,
                  [&](const PGresult* row) { sequences[textAt(row, 0)] = textAt(row, 1); });
    std::map<QByteArray, qint64> keys;
    for (const auto& [table, sequence] : sequences)
        keys[table] = book_.number("SELECT last_value - (NOT is_called)::int FROM " + sequence);
    return keys;
}

}  // namespace database
