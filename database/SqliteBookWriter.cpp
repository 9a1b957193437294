// SPDX-License-Identifier: MIT
#include "database/SqliteBookWriter.h"

#include <sqlite3.h>

namespace database {

namespace {

// A rollback journal notes only what was there before, so filling an empty book writes each page
// once; the write-ahead log would write all of it twice.
constexpr const char* Begin =
    "PRAGMA journal_mode=DELETE; PRAGMA cache_size=-200000; BEGIN EXCLUSIVE";
constexpr const char* BackToDailyWork = "PRAGMA cache_size=-2000; PRAGMA journal_mode=WAL";

void bindValue(sqlite::Statement& row, int parameter, const Value& value) {
    if (const auto* number = std::get_if<qint64>(&value))
        row.bind(parameter, *number);
    else if (const auto* real = std::get_if<double>(&value))
        row.bind(parameter, *real);
    else if (const auto* money = std::get_if<core::Money>(&value))
        row.bind(parameter, money->toDouble());
    else if (const auto* text = std::get_if<QByteArray>(&value))
        row.bind(parameter, *text);
    else
        row.bindNull(parameter);
}

}  // namespace

SqliteBookWriter::SqliteBookWriter(sqlite::Database& book) : book_(book) {
    try {
        book_.run(Begin);
    } catch (...) {
        leave();
        throw;
    }
}

SqliteBookWriter::~SqliteBookWriter() {
    statements_.clear();
    leave();
}

/// Undoes what was not committed. Whatever fails here failed before, and was told then.
void SqliteBookWriter::leave() {
    sqlite3* handle = book_.handle();
    if (!sqlite3_get_autocommit(handle))
        sqlite3_exec(handle, "ROLLBACK", nullptr, nullptr, nullptr);
    sqlite3_exec(handle, BackToDailyWork, nullptr, nullptr, nullptr);
}

void SqliteBookWriter::add(const Table& table, const std::vector<Value>& values) {
    Q_ASSERT(values.size() == table.columns.size());
    sqlite::Statement& row = statement(table);
    for (size_t at = 0; at < values.size(); ++at)
        bindValue(row, static_cast<int>(at) + 1, values[at]);
    row.run();
}

void SqliteBookWriter::clear(const Table& table) {
    book_.run("DELETE FROM " + table.name);
}

void SqliteBookWriter::continueAfter(const Table& table, qint64 lastKey) {
    const QByteArray name = '\'' + table.name + '\'';
    book_.run("DELETE FROM sqlite_sequence WHERE name = " + name +
              "; INSERT INTO sqlite_sequence (name, seq) VALUES (" + name + ", " +
              QByteArray::number(lastKey) + ")");
}

void SqliteBookWriter::commit() {
    book_.run("COMMIT");
}

sqlite::Statement& SqliteBookWriter::statement(const Table& table) {
    std::unique_ptr<sqlite::Statement>& known = statements_[&table];
    if (!known) {
        QByteArray marks = QByteArray("?,").repeated(static_cast<qsizetype>(table.columns.size()));
        marks.chop(1);
        known = std::make_unique<sqlite::Statement>(
            book_,
            "INSERT INTO " + table.name + " (" + table.columnList() + ") VALUES (" + marks + ')');
    }
    return *known;
}

}  // namespace database
