// SPDX-License-Identifier: MIT
#include "database/Postgres.h"

#include <libpq-fe.h>

#include <memory>

#include "platform/ado/postgres/Failures.h"
#include "platform/ado/postgres/Handle.h"

namespace database {

using namespace Qt::StringLiterals;

namespace {

ado::postgres::Address addressOf(const ServerCatalogue& catalogue) {
    return {.host = catalogue.host,
            .port = catalogue.port,
            .user = catalogue.user,
            .password = catalogue.password,
            .catalog = catalogue.name,
            .allowsPlain = catalogue.allowsPlain};
}

/// SQLSTATE of a failure of which the server tells nothing.
constexpr auto ConnectionLost = "08006";

struct Free {
    void operator()(char* text) const { PQfreemem(text); }
};

QByteArray taken(char* text) {
    return std::unique_ptr<char, Free>(text).get();
}

}  // namespace

ServerCatalogue ServerCatalogue::at(const QString& place, const QString& name) {
    ado::postgres::Address address;
    address.catalog = name;
    address.place(place);
    return {.host = address.host,
            .port = address.port,
            .user = {},
            .password = {},
            .name = name,
            .allowsPlain = address.allowsPlain};
}

QString ServerCatalogue::shown() const {
    return addressOf(*this).shown();
}

QString ServerCatalogue::dataSource() const {
    return u"postgresql:"_s + addressOf(*this).source();
}

namespace postgres {

Database::Database(const ServerCatalogue& catalogue)
    : connection_(ado::postgres::Handle::connected(addressOf(catalogue))) {
    PQsetNoticeProcessor(
        connection_, [](void*, const char*) {}, nullptr);
    try {
        run("SET search_path = public, pg_temp; SET datestyle = ISO, MDY;"
            "SET extra_float_digits = 1; SET jit = off");
    } catch (...) {
        PQfinish(connection_);
        throw;
    }
}

Database::~Database() {
    PQfinish(connection_);
}

void Database::run(const QByteArray& statements) {
    PQclear(checked(PQexec(connection_, statements.constData())));
}

qint64 Database::number(const QByteArray& statement) {
    const ado::postgres::Result result(checked(PQexec(connection_, statement.constData())));
    if (PQntuples(result.get()) == 0) return 0;
    const QByteArray text = PQgetvalue(result.get(), 0, 0);
    return text == "t" ? 1 : text.toLongLong();
}

void Database::eachRow(const QByteArray& statement,
                       const std::function<void(const pg_result*)>& row) {
    if (!PQsendQuery(connection_, statement.constData())) fail(nullptr);
    PQsetSingleRowMode(connection_);
    while (PGresult* next = PQgetResult(connection_)) {
        const ado::postgres::Result result(checked(next));
        if (PQresultStatus(next) == PGRES_SINGLE_TUPLE) row(next);
    }
}

void Database::copyIn(const QByteArray& statement, const QByteArray& lines) {
    PQclear(checked(PQexec(connection_, statement.constData())));
    if (PQputCopyData(connection_, lines.constData(), static_cast<int>(lines.size())) != 1 ||
        PQputCopyEnd(connection_, nullptr) != 1)
        fail(nullptr);
    finish();
}

/// Reads the answers to the end; fails with the first one that tells of a failure.
void Database::finish() {
    ado::postgres::Result failed;
    while (PGresult* next = PQgetResult(connection_)) {
        ado::postgres::Result result(next);
        if (!failed && PQresultStatus(next) != PGRES_COMMAND_OK) failed = std::move(result);
    }
    if (failed) fail(failed.get());
}

QByteArray Database::name(const QString& text) const {
    const QByteArray utf8 = text.toUtf8();
    return taken(PQescapeIdentifier(connection_, utf8, static_cast<size_t>(utf8.size())));
}

QByteArray Database::literal(const QString& text) const {
    const QByteArray utf8 = text.toUtf8();
    return taken(PQescapeLiteral(connection_, utf8, static_cast<size_t>(utf8.size())));
}

QByteArray Database::encrypted(const QString& password, const QString& role) const {
    char* secret = PQencryptPasswordConn(connection_, password.toUtf8(), role.toUtf8(), nullptr);
    if (!secret) fail(nullptr);
    return taken(secret);
}

/// The result itself, unless it tells of a failure.
PGresult* Database::checked(PGresult* result) const {
    switch (PQresultStatus(result)) {
        case PGRES_COMMAND_OK:
        case PGRES_TUPLES_OK:
        case PGRES_SINGLE_TUPLE:
        case PGRES_COPY_IN:
            return result;
        default:
            const ado::postgres::Result failed(result);
            fail(failed.get());
    }
}

void Database::fail(const PGresult* result) const {
    QStringList lines;
    for (const int part : {PG_DIAG_MESSAGE_PRIMARY, PG_DIAG_MESSAGE_DETAIL, PG_DIAG_CONTEXT})
        if (const char* text = PQresultErrorField(result, part)) lines << QString::fromUtf8(text);
    if (lines.isEmpty()) lines << QString::fromUtf8(PQerrorMessage(connection_)).simplified();
    const char* code = PQresultErrorField(result, PG_DIAG_SQLSTATE);
    throw ado::postgres::failure(QString::fromLatin1(code ? code : ConnectionLost),
                                 lines.join(u'\n'));
}

Transaction::~Transaction() {
    if (!isOpen_) return;
    try {
        book_.run("ROLLBACK");
    } catch (const core::Failure&) {
        // The connection is lost, and the server undoes it by itself.
    }
}

void Transaction::commit() {
    book_.run("COMMIT");
    isOpen_ = false;
}

}  // namespace postgres

}  // namespace database
