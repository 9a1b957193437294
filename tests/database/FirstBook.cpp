// SPDX-License-Identifier: MIT
#include "tests/database/FirstBook.h"

#include <QDir>
#include <QFile>
#include <QRegularExpression>

#include "database/Book.h"
#include "platform/ado/postgres/BulkAccess.h"
#include "platform/ado/sqlite/BulkAccess.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;
using database::BookPlace;
using ServerAccess = ado::postgres::BulkAccess;

namespace {

QByteArray fixture(const QString& name) {
    QFile file(QStringLiteral(FIRST_FOLDER) + u'/' + name);
    if (!file.open(QIODevice::ReadOnly)) throw std::runtime_error("a fixture is missing");
    return file.readAll();
}

/// What one book has and another may not, one thing a line.
const QByteArray ServerSchema[] = {
    "SELECT concat_ws(' ', c.relname, a.attname, format_type(a.atttypid, a.atttypmod), "
    "a.attnotnull,"
    " a.attidentity, a.attcollation::regcollation, pg_get_expr(d.adbin, d.adrelid))"
    "  FROM pg_class c JOIN pg_attribute a ON a.attrelid = c.oid"
    "  LEFT JOIN pg_attrdef d ON d.adrelid = c.oid AND d.adnum = a.attnum"
    " WHERE c.relnamespace = 'public'::regnamespace AND c.relkind IN ('r', 'v') AND a.attnum > 0"
    " ORDER BY c.relname, a.attnum",
    "SELECT indexdef FROM pg_indexes WHERE schemaname = 'public' ORDER BY 1",
    "SELECT concat_ws(' ', relname, relkind, relowner::regrole, relrowsecurity,"
    " CASE relkind WHEN 'v' THEN pg_get_viewdef(oid) END) FROM pg_class"
    " WHERE relnamespace = 'public'::regnamespace ORDER BY 1",
    "SELECT concat_ws(' ', conname, pg_get_constraintdef(oid)) FROM pg_constraint"
    " WHERE connamespace = 'public'::regnamespace ORDER BY 1",
    "SELECT concat_ws(' ', tablename, policyname, permissive, roles, cmd, qual, with_check)"
    "  FROM pg_policies ORDER BY 1",
    // Rights: of relations, columns, functions, languages, the schema, the catalogue.
    "SELECT concat_ws(' ', o.what, pg_get_userbyid(a.grantee), a.privilege_type, a.is_grantable)"
    "  FROM (SELECT relname::text AS what, relacl AS acl FROM pg_class"
    "         WHERE relnamespace = 'public'::regnamespace"
    "        UNION ALL SELECT c.attrelid::regclass::text || '.' || attname, attacl"
    "                    FROM pg_attribute c WHERE attrelid >= 16384"
    "        UNION ALL SELECT oid::regprocedure::text, proacl FROM pg_proc"
    "        UNION ALL SELECT lanname, lanacl FROM pg_language"
    "        UNION ALL SELECT nspname, nspacl FROM pg_namespace WHERE nspname = 'public'"
    "        UNION ALL SELECT 'catalogue', datacl FROM pg_database"
    "                   WHERE datname = current_database()) o,"
    "       LATERAL aclexplode(o.acl) a ORDER BY 1",
    "SELECT concat_ws(' ', setrole::regrole, setconfig) FROM pg_db_role_setting"
    " WHERE setdatabase = (SELECT oid FROM pg_database WHERE datname = current_database())",
};

QStringList serverSchema(const BookPlace& place) {
    ServerAccess book(place.server);
    QStringList all;
    for (const QByteArray& query : ServerSchema) all += book.texts(query);
    return all.replaceInStrings(place.name, u"X"_s);
}

QStringList fileSchema(const BookPlace& place) {
    QStringList all = database::opened(place)->texts(
        "SELECT type || ' ' || name || coalesce(sql, '') FROM sqlite_master ORDER BY 1");
    all.replaceInStrings(QRegularExpression(u"--[^\n]*|\\s"_s), {});
    return all;
}

QString shown(const ado::BulkValue& value) {
    if (const auto* number = std::get_if<qint64>(&value)) return QString::number(*number);
    if (const auto* real = std::get_if<double>(&value)) return QString::number(*real, 'g', 17);
    if (const auto* money = std::get_if<core::Money>(&value)) return money->toPlainText();
    if (const auto* text = std::get_if<QByteArray>(&value)) return u'"' + QString::fromUtf8(*text);
    return u"null"_s;
}

}  // namespace

BookPlace FirstBook::inFile(const QString& folder) {
    const BookPlace place{folder, {}, u"livro"_s};
    QDir().mkpath(folder);
    QFile file(database::bookFile(folder, place.name));
    if (!file.open(QIODevice::NewOnly)) throw std::runtime_error("the file cannot be made");
    ado::sqlite::BulkAccess book(file.fileName());
    book.execute("PRAGMA journal_mode=WAL");
    book.execute(fixture(u"sqlite.sql"_s));
    book.execute(fixture(u"rows.sql"_s));
    return place;
}

BookPlace FirstBook::placeOnServer(const QString& name) {
    return {.folder = {},
            .server = {.host = support::Server::instance().folder(),
                       .port = {},
                       .user = QString::fromLatin1(support::Server::User),
                       .password = {},
                       .catalog = name},
            .name = name};
}

BookPlace FirstBook::onServer(const QString& name) {
    const BookPlace place = placeOnServer(name);
    ServerAccess(placeOnServer(u"postgres"_s).server)
        .execute("CREATE DATABASE " + name.toLatin1() +
                 " TEMPLATE template0 ENCODING 'UTF8' LOCALE 'C'");
    const auto named = [&](QByteArray text) {
        return text.replace("{catalogue}", name.toLatin1())
            .replace("{operator}", "posto_" + name.toLatin1())
            .replace("{owner}", name.toLatin1() + "_dono");
    };
    ServerAccess book(place.server);
    book.execute(
        named("CREATE ROLE {owner} NOLOGIN; CREATE ROLE {operator} LOGIN PASSWORD 'segredo';"
              "ALTER DATABASE {catalogue} OWNER TO {owner};"
              "GRANT CREATE, USAGE ON SCHEMA public TO {owner}; SET ROLE {owner}"));
    book.execute(fixture(u"postgresql.sql"_s));
    book.execute("RESET ROLE");
    book.execute(named(fixture(u"roles.sql"_s)));
    book.execute(fixture(u"rows.sql"_s));
    return place;
}

QStringList FirstBook::rowsOf(const BookPlace& place) {
    const std::unique_ptr<ado::BulkAccess> book = database::opened(place);
    QStringList all;
    for (const ado::TableShape& shape : book->tables()) {
        const QByteArray name = shape.name.toLower();
        if (name == "tboperacoes" || name == "tbversao") continue;
        book->eachRow(shape, [&](const ado::BulkRow& row) {
            QStringList cells{QString::fromLatin1(name)};
            for (const ado::BulkValue& value : row) cells << shown(value);
            all << cells.join(u'|');
        });
    }
    return all;
}

QStringList FirstBook::schemaOf(const BookPlace& place) {
    QStringList all = place.isOnServer() ? serverSchema(place) : fileSchema(place);
    const std::unique_ptr<ado::BulkAccess> book = database::opened(place);
    all << u"left: %1"_s.arg(book->lastKeys()["tbzelmar_movimentos_inactivos"]);
    return all << u"version: %1"_s.arg(book->parts().contains("tbversao")
                                           ? book->number("SELECT sum(versao) FROM tbVersao")
                                           : 0);
}
