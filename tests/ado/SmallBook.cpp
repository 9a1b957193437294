// SPDX-License-Identifier: MIT
#include "SmallBook.h"

#include <gtest/gtest.h>

using namespace Qt::StringLiterals;

namespace {

constexpr auto Tables = R"(
    CREATE TABLE tbMov (id INTEGER PRIMARY KEY AUTOINCREMENT, socio INTEGER, tipo VARCHAR(3),
        data DATETIME, valor MONEY, taxa DOUBLE, nome VARCHAR(10), obs TEXT, pequeno SMALLINT,
        grande BIGINT, estado TEXT DEFAULT 'novo');
    CREATE INDEX ixMov ON tbMov (socio, tipo);
    CREATE TABLE tbSoma (socio INTEGER, credito REAL, docs INTEGER);
    CREATE TABLE tbConta (proximo INTEGER);
    CREATE TABLE tbHosp (hosp_id INTEGER PRIMARY KEY, code VARCHAR(5), nome VARCHAR(40));
    CREATE VIEW vwMov AS SELECT tbMov.*, 'ACTIVO' AS ficheiro FROM tbMov;)";

}  // namespace

SmallBook::SmallBook() {
    EXPECT_EQ(sqlite3_open(file().toUtf8().constData(), &other_), SQLITE_OK);
    exec(QString::fromLatin1(Tables));
}

SmallBook::~SmallBook() {
    sqlite3_close_v2(other_);
}

ado::ConnectionPtr SmallBook::connect(const QString& provider, int timeoutSeconds) const {
    auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString =
        u"Provider=%1;Persist Security Info=True;User ID=ana;Password=x;Initial Catalog=livro;"
        u"Data Source=sqlite:%2;Connect Timeout=15"_s.arg(provider, folder());
    connection->CommandTimeout = timeoutSeconds;
    connection->Open();
    return connection;
}

void SmallBook::exec(const QString& statements) {
    char* error = nullptr;
    sqlite3_exec(other_, statements.toUtf8().constData(), nullptr, nullptr, &error);
    EXPECT_EQ(error, nullptr) << error;
    sqlite3_free(error);
}

QString SmallBook::value(const QString& statement) {
    sqlite3_stmt* prepared = nullptr;
    EXPECT_EQ(sqlite3_prepare_v2(other_, statement.toUtf8().constData(), -1, &prepared, nullptr),
              SQLITE_OK)
        << sqlite3_errmsg(other_);
    QString text = u"-"_s;
    if (sqlite3_step(prepared) == SQLITE_ROW) {
        const auto* found = reinterpret_cast<const char*>(sqlite3_column_text(prepared, 0));
        text = found ? QString::fromUtf8(found) : u"NULL"_s;
    }
    sqlite3_finalize(prepared);
    return text;
}

QString SmallBook::stored(const QString& expression, const QString& table) {
    return value(u"SELECT typeof(%1) || ' ' || quote(%1) FROM %2"_s.arg(expression, table));
}

ado::RecordsetPtr openRows(const QString& statement, const ado::ConnectionPtr& connection,
                           ado::CursorType cursor, ado::LockType lock) {
    ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(statement, connection, cursor, lock, ado::adCmdUnknown);
    return rows;
}
