// SPDX-License-Identifier: MIT
#include "benchmarks/Books.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QStorageInfo>
#include <cstdio>

#include "benchmarks/Bare.h"
#include "benchmarks/BenchServer.h"
#include "boundary/Login.h"
#include "database/Book.h"
#include "database/Schema.h"
#include "platform/ado/postgres/BulkAccess.h"
#include "platform/ado/sqlite/BulkAccess.h"
#include "platform/registry/LoginValues.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

const QString Catalogue = u"zelmars"_s;

/// Where the system keeps files in memory.
const QString Memory = u"/dev/shm"_s;

/// A book of another version of the schema is another book.
QString versioned(const QString& name) {
    return name + u"_v%1"_s.arg(database::SchemaVersion);
}

/// One fixed day, so that a book made earlier and one made today hold the same.
const QDate AsOf(2026, 11, 20);

database::BookSizes largeSizes() {
    database::BookSizes sizes;
    sizes.members = 100'000;
    sizes.relatives = 230'000;
    sizes.membersLeft = 2'000;
    sizes.movements = 1'000'000;
    sizes.historyPerYear = 3'500;
    sizes.accumulators = 1'000'000;
    return sizes;
}

void tell(const QString& name) {
    std::printf("Making the book %s …\n", qUtf8Printable(name));
    std::fflush(stdout);
}

using Fill = std::function<void(ado::BulkAccess&)>;

Book fileBook(const QString& name, const database::BookSizes& sizes, const Fill& more) {
    Book made{Engine::Sqlite, QDir::current().absoluteFilePath(u"build/bench/books/"_s + name), {}};
    if (!QFileInfo::exists(made.file())) {
        tell(name);
        // Under another name first, so that a book that was cut short is never taken for whole.
        const QString half = made.folder + u"-half"_s;
        QDir(half).removeRecursively();
        database::createBook(half, Catalogue);
        database::fillSample(half, Catalogue, sizes, AsOf);
        if (more) {
            ado::sqlite::BulkAccess book(database::bookFile(half, Catalogue));
            more(book);
        }
        QDir().rename(half, made.folder);
    }
    return made;
}

Book serverBook(const QString& name) {
    return {Engine::Postgres, BenchServer::instance().folder(), name};
}

Book serverBook(const QString& name, const database::BookSizes& sizes, const Fill& more) {
    const Book made = serverBook(name);
    ado::postgres::BulkAccess server(serverBook(u"postgres"_s).server());
    if (server.number(
            "SELECT EXISTS (SELECT FROM pg_database WHERE datname = " + server.literal(name) + ')'))
        return made;
    tell(name + u" (server)"_s);
    const Book half = serverBook(name + u"_half"_s);
    server.execute("DROP DATABASE IF EXISTS " + server.name(half.catalogue));
    server.execute("CREATE DATABASE " + server.name(half.catalogue) + " TEMPLATE template0");
    database::createBook(half.server());
    database::fillSample(half.server(), sizes, AsOf);
    {
        // The rows of a book that grew by itself lie in the order of their numbers.
        ado::postgres::BulkAccess book(half.server());
        if (more) more(book);
        book.execute("CLUSTER tbZelmar_Movimentos USING tbZelmar_Movimentos_pkey");
        book.execute("VACUUM ANALYZE");
    }
    server.execute("ALTER DATABASE " + server.name(half.catalogue) + " RENAME TO " +
                   server.name(name));
    return made;
}

Book book(Engine engine, const QString& name, const database::BookSizes& sizes,
          const Fill& more = {}) {
    return engine == Engine::Sqlite ? fileBook(versioned(name), sizes, more)
                                    : serverBook(versioned(name), sizes, more);
}

/// Adds what the two members have beside the sample.
void addMuch(ado::BulkAccess& book) {
    const auto countTo = [](int count) {
        return "WITH RECURSIVE n (i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < " +
               QByteArray::number(count) + ") ";
    };
    book.execute(countTo(50'000) +
                 "INSERT INTO tbZelmar_Movimentos (movimento_no, socio_id, codABC, rubrica_id, "
                 "data, tipo, doc_data, doc_no, doc_valor, doc_iva, incidencia, comparticipacao, "
                 "iliquido, liquido, credito, debito, modo_pagamento) SELECT 100000 + i, " +
                 QByteArray::number(MemberOfMovements) + ", 'A', " +
                 QByteArray::number(FranchiseRubric) +
                 ", '2026-03-01 00:00:00', 'DOC', '2026-02-01 00:00:00', 'P1', 20, 3, 20, 12, 12, "
                 "12, 12, 12, 'TRF' FROM n");
    book.execute(countTo(6'000) +
                 "INSERT INTO tbSocios_Acumulados (socio_id, codABC, rubrica_id, rubrica_id_main, "
                 "debito_ac, credito_ac, no_docs) SELECT " +
                 QByteArray::number(MemberOfAccumulators) +
                 ", 'A', 100000 + i, 100000 + i / 20, 1, 1, 1 FROM n");
}

std::vector<Case> cases(const Book& book, const QByteArray& query) {
    const std::unique_ptr<BareRows> rows = bareSqlite(book)->rows(query);
    std::vector<Case> found;
    while (rows->next())
        found.push_back({static_cast<qint32>(rows->integer(0)), QString::fromUtf8(rows->text(1)),
                         static_cast<qint32>(rows->integer(2))});
    return found;
}

}  // namespace

QString nameOf(Engine engine) {
    return engine == Engine::Sqlite ? u"sqlite"_s : u"postgresql"_s;
}

QString Book::file() const {
    return database::bookFile(folder, Catalogue);
}

ado::postgres::Address Book::server() const {
    return {folder, {}, QString::fromLatin1(BenchServer::User), {}, catalogue};
}

database::BookPlace Book::place() const {
    if (engine == Engine::Sqlite) return {folder, {}, Catalogue};
    return {{}, server(), catalogue};
}

QString Book::connectionString() const {
    const bool isFile = engine == Engine::Sqlite;
    return u"Provider=SQLOLEDB.1;User ID=%1;Initial Catalog=%2;Data Source=%3:%4"_s.arg(
        QString::fromLatin1(BenchServer::User), isFile ? Catalogue : catalogue, nameOf(engine),
        folder);
}

Book sampleBook(Engine engine) {
    return book(engine, u"sample"_s, {});
}

Book heavyBook(Engine engine) {
    return book(engine, u"heavy"_s, {}, addMuch);
}

Book largeBook(Engine engine) {
    return book(engine, u"large"_s, largeSizes());
}

bool copiesInMemory() {
    constexpr qint64 Enough = qint64{2} << 30;  // bytes: the large book and its journal
    static const bool enough = [] {
        const QStorageInfo memory(Memory);
        return memory.isValid() && memory.fileSystemType() == "tmpfs" && !memory.isReadOnly() &&
               memory.bytesAvailable() > Enough;
    }();
    return enough;
}

BookCopy::BookCopy(const Book& original) : book_(original) {
    if (book_.engine == Engine::Sqlite) {
        if (copiesInMemory())
            book_.folder =
                Memory + u"/zelmars-bench-%1-%2"_s.arg(QCoreApplication::applicationPid())
                             .arg(QFileInfo(original.folder).fileName());
        book_.folder += u"-copy"_s;
        QDir(book_.folder).removeRecursively();
        QDir().mkpath(book_.folder);
        QFile::copy(original.file(), book_.file());
    } else {
        book_.catalogue += u"_copy"_s;
        ado::postgres::BulkAccess server(serverBook(u"postgres"_s).server());
        server.execute("DROP DATABASE IF EXISTS " + server.name(book_.catalogue) + " WITH (FORCE)");
        // A catalogue that is copied must have no connections; those of this program are opened
        // anew.
        server.number(
            "SELECT count(pg_terminate_backend(pid, 5000)) FROM pg_stat_activity WHERE datname = " +
            server.literal(original.catalogue));
        server.execute("CREATE DATABASE " + server.name(book_.catalogue) + " TEMPLATE " +
                       server.name(original.catalogue));
    }
}

BookCopy::~BookCopy() {
    if (book_.engine == Engine::Sqlite) {
        QDir(book_.folder).removeRecursively();
    } else {
        ado::postgres::BulkAccess server(serverBook(u"postgres"_s).server());
        server.execute("DROP DATABASE " + server.name(book_.catalogue) + " WITH (FORCE)");
    }
}

void use(const Book& book) {
    if (book.engine == Engine::Sqlite)
        database::writeSettings(book.folder, Catalogue);
    else
        registry::LoginValues{.dtUser = QString::fromLatin1(BenchServer::User),
                              .dtInitialCatalog = book.catalogue,
                              .dtDataSource = u"postgresql:"_s + book.folder}
            .write();
    boundary::Login();
}

std::vector<Case> usedCases(const Book& book, int count) {
    // Spread over the book by the remainder of a product with a prime.
    return cases(book,
                 "SELECT a.socio_id, a.codABC, a.rubrica_id FROM tbSocios_Acumulados a "
                 "JOIN tbSocios s ON s.socio_id = a.socio_id "
                 "WHERE a.rubrica_id > 0 AND length(s.nib) = 21 AND a.rowid IN "
                 "(SELECT rowid FROM tbSocios_Acumulados ORDER BY (rowid * 7919) % 100003 LIMIT " +
                     QByteArray::number(count * 3) + ") LIMIT " + QByteArray::number(count));
}

std::vector<Case> freshCases(const Book& book, int count) {
    return cases(book,
                 "SELECT s.socio_id, 'A', p.rubrica_id FROM "
                 "(SELECT socio_id FROM tbSocios WHERE length(nib) = 21 "
                 "ORDER BY (socio_id * 7919) % 100003 LIMIT 300) s, tbZelmar_Plafonds p "
                 "WHERE p.rubrica_id_main IS NOT NULL AND NOT EXISTS "
                 "(SELECT 1 FROM tbSocios_Acumulados a WHERE a.socio_id = s.socio_id AND "
                 "a.codABC = 'A' AND a.rubrica_id = p.rubrica_id) LIMIT " +
                     QByteArray::number(count));
}

}  // namespace benchmarks
