// SPDX-License-Identifier: MIT
#include "database/ServerBook.h"

#include <libpq-fe.h>

#include <memory>

#include "database/SchemaText.h"
#include "platform/core/Failure.h"

namespace database {

using namespace Qt::StringLiterals;

namespace {

using Connection = std::unique_ptr<PGconn, decltype(&PQfinish)>;
using Result = std::unique_ptr<PGresult, decltype(&PQclear)>;

core::Failure failure(const ServerCatalogue& catalogue, PGconn* connection, const char* code) {
    return core::Failure(core::DatabaseFailure,
                         u"Não foi possível criar o livro «%1» em «%2»: %3"_s.arg(
                             catalogue.name, catalogue.host,
                             QString::fromUtf8(PQerrorMessage(connection)).simplified()),
                         QString::fromLatin1(code));
}

Connection connect(const ServerCatalogue& catalogue) {
    const QByteArray values[] = {catalogue.host.toUtf8(), catalogue.port.toUtf8(),
                                 catalogue.user.toUtf8(), catalogue.password.toUtf8(),
                                 catalogue.name.toUtf8()};
    const char* const names[] = {
        "host", "port", "user", "password", "dbname", "client_encoding", "connect_timeout",
        nullptr};
    const char* const texts[] = {values[0], values[1], values[2], values[3],
                                 values[4], "UTF8",    "15",      nullptr};
    return {PQconnectdbParams(names, texts, 0), &PQfinish};
}

}  // namespace

void createBook(const ServerCatalogue& catalogue) {
    const Connection connection = connect(catalogue);
    if (PQstatus(connection.get()) != CONNECTION_OK)
        throw failure(catalogue, connection.get(), "08001");
    // Several statements in one text are one transaction.
    const QByteArray statements = "SET client_min_messages = warning;" +
                                  schemaText(u"postgresql.sql"_s) + schemaText(u"codes.sql"_s);
    const Result result(PQexec(connection.get(), statements.constData()), &PQclear);
    if (PQresultStatus(result.get()) != PGRES_COMMAND_OK)
        throw failure(catalogue, connection.get(),
                      PQresultErrorField(result.get(), PG_DIAG_SQLSTATE));
}

}  // namespace database
