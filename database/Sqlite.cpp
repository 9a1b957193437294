// SPDX-License-Identifier: MIT
#include "database/Sqlite.h"

#include <sqlite3.h>

#include "platform/ado/sqlite/Failures.h"

namespace database::sqlite {

namespace {

[[noreturn]] void fail(sqlite3* handle, int result) {
    const char* text = handle ? sqlite3_errmsg(handle) : sqlite3_errstr(result);
    throw ado::sqlite::failure(handle ? sqlite3_extended_errcode(handle) : result,
                               QString::fromUtf8(text));
}

}  // namespace

Database::Database(const QString& file, Mode mode) {
    const int flags = SQLITE_OPEN_READWRITE | (mode == Mode::CreateNew ? SQLITE_OPEN_CREATE : 0);
    const int result = sqlite3_open_v2(file.toUtf8().constData(), &handle_, flags, nullptr);
    if (result == SQLITE_OK) return;
    const core::Failure failure =
        ado::sqlite::failure(result, QString::fromUtf8(sqlite3_errmsg(handle_)));
    sqlite3_close(handle_);
    throw failure;
}

Database::~Database() {
    sqlite3_close(handle_);
}

void Database::check(int result) const {
    if (result != SQLITE_OK && result != SQLITE_ROW && result != SQLITE_DONE) fail(handle_, result);
}

void Database::run(const QByteArray& statements) {
    check(sqlite3_exec(handle_, statements.constData(), nullptr, nullptr, nullptr));
}

qint64 Database::number(const QByteArray& statement) {
    Statement query(*this, statement);
    return query.step() ? sqlite3_column_int64(query.handle(), 0) : 0;
}

Statement::Statement(Database& database, const QByteArray& text) : database_(database) {
    database_.check(sqlite3_prepare_v2(database_.handle(), text.constData(),
                                       static_cast<int>(text.size()), &handle_, nullptr));
}

Statement::~Statement() {
    sqlite3_finalize(handle_);
}

void Statement::bindNull(int parameter) {
    database_.check(sqlite3_bind_null(handle_, parameter));
}

void Statement::bind(int parameter, qint64 value) {
    database_.check(sqlite3_bind_int64(handle_, parameter, value));
}

void Statement::bind(int parameter, double value) {
    database_.check(sqlite3_bind_double(handle_, parameter, value));
}

void Statement::bind(int parameter, const QByteArray& utf8) {
    database_.check(sqlite3_bind_text(handle_, parameter, utf8.constData(),
                                      static_cast<int>(utf8.size()), SQLITE_STATIC));
}

void Statement::run() {
    while (step()) {
    }
    database_.check(sqlite3_reset(handle_));
}

bool Statement::step() {
    const int result = sqlite3_step(handle_);
    database_.check(result);
    return result == SQLITE_ROW;
}

}  // namespace database::sqlite
