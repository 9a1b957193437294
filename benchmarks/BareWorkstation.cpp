// SPDX-License-Identifier: MIT
// What a workstation does at the least: bare_workstation NUMBER POSTINGS
//
// The queries and locks of a posting with the engine's client library and nothing around them.
// It speaks as the workstation of the tests does: "ready", then a line for each posting.
#include <fcntl.h>
#include <libpq-fe.h>
#include <sqlite3.h>

#include <QCoreApplication>
#include <QElapsedTimer>
#include <cstdio>
#include <memory>
#include <string_view>

#include "coverage/Queries.h"
#include "platform/registry/LoginValues.h"
#include "tests/workstations/Jobs.h"

using namespace Qt::StringLiterals;

namespace {

[[noreturn]] void stop(const char* text) {
    std::printf("box %s\n", text);
    std::exit(1);
}

/// The first row of a query; empty for none.
using Row = QList<QByteArray>;

class BareBook {
public:
    virtual ~BareBook() = default;
    virtual Row run(const QString& query) = 0;
    virtual void hold(const QByteArray& row) = 0;
    virtual void letGo(const QByteArray& row) = 0;
};

class SqliteBook : public BareBook {
public:
    explicit SqliteBook(const QString& file) {
        if (sqlite3_open(file.toUtf8().constData(), &handle_) != SQLITE_OK) stop("open");
        sqlite3_busy_timeout(handle_, 30000);
        run(u"PRAGMA synchronous=FULL"_s);
        locks_ = ::open((file + u"-bare-locks"_s).toUtf8().constData(), O_RDWR | O_CREAT, 0600);
    }
    Row run(const QString& query) override {
        const QByteArray text = query.toUtf8();
        sqlite3_stmt* prepared = nullptr;
        if (sqlite3_prepare_v2(handle_, text.constData(), -1, &prepared, nullptr) != SQLITE_OK)
            stop(sqlite3_errmsg(handle_));
        Row row;
        int step = sqlite3_step(prepared);
        for (int at = 0; step == SQLITE_ROW && at < sqlite3_column_count(prepared); ++at)
            row += reinterpret_cast<const char*>(sqlite3_column_text(prepared, at));
        while (step == SQLITE_ROW) step = sqlite3_step(prepared);
        if (step != SQLITE_DONE) stop(sqlite3_errmsg(handle_));
        sqlite3_finalize(prepared);
        return row;
    }
    void hold(const QByteArray& row) override { lock(row, F_WRLCK, F_OFD_SETLKW); }
    void letGo(const QByteArray& row) override { lock(row, F_UNLCK, F_OFD_SETLK); }

private:
    void lock(const QByteArray& row, short type, int how) const {
        // The same in every process, which qHash is not.
        const std::size_t hash = std::hash<std::string_view>{}(row.constData());
        struct flock range {};
        range.l_type = type;
        range.l_whence = SEEK_SET;
        range.l_start = static_cast<off_t>(hash >> 2);
        range.l_len = 1;
        if (::fcntl(locks_, how, &range) != 0) stop("lock");
    }
    sqlite3* handle_ = nullptr;
    int locks_ = -1;
};

class ServerBook : public BareBook {
public:
    ServerBook(const QString& host, const QString& catalogue, const QString& user)
        : handle_(PQsetdbLogin(host.toUtf8(), nullptr, nullptr, nullptr, catalogue.toUtf8(),
                               user.toUtf8(), nullptr)) {}
    Row run(const QString& query) override {
        PGresult* result = PQexec(handle_, query.toUtf8());
        if (PQresultStatus(result) != PGRES_TUPLES_OK && PQresultStatus(result) != PGRES_COMMAND_OK)
            stop(PQerrorMessage(handle_));
        Row row;
        for (int at = 0; PQntuples(result) > 0 && at < PQnfields(result); ++at)
            row += PQgetvalue(result, 0, at);
        PQclear(result);
        return row;
    }
    void hold(const QByteArray& row) override { lock(u"lock"_s, row); }
    void letGo(const QByteArray& row) override { lock(u"unlock"_s, row); }

private:
    void lock(const QString& how, const QByteArray& row) {
        run(u"SELECT pg_advisory_%1(hashtextextended('%2', 0))"_s.arg(how, QString::fromUtf8(row)));
    }
    PGconn* handle_;
};

/// The book that the registry names.
std::unique_ptr<BareBook> openBook() {
    registry::LoginValues values;
    if (!values.take().isEmpty()) stop("no registry");
    const QString place = values.dtDataSource.section(u':', 1);
    if (values.dtDataSource.startsWith(u"sqlite:"_s))
        return std::make_unique<SqliteBook>(place + u'/' + values.dtInitialCatalog + u".db"_s);
    return std::make_unique<ServerBook>(place, values.dtInitialCatalog, values.dtUser);
}

/// One posting.
class Posting {
public:
    Posting(BareBook& book, office::Job job, QString document)
        : book_(book), job_(std::move(job)), document_(std::move(document)) {}

    void run() {
        book_.run(u"select * from tbzelmar_movimentos where movimento_id = 0"_s);
        tryOut();
        book_.run(coverage::queries::member(job_.socio_id));
        if (job_.isBill) takeCheque();
        save(drawNumber());
        addToAccumulator();
    }

private:
    void tryOut() {
        using namespace coverage::queries;
        const Row row = book_.run(rubric(job_.rubrica_id));
        const int main = row[1].toInt();
        const bool hasFranchise = row.last().toDouble() != 0;
        if (lookUpAccumulator().isEmpty())
            book_.run(u"INSERT INTO tbSocios_Acumulados VALUES (%1, '%2', %3, %4, 0, 0, 0)"_s
                          .arg(job_.socio_id)
                          .arg(job_.codABC)
                          .arg(job_.rubrica_id)
                          .arg(main));
        lookUpAccumulator();
        book_.run(creditOfHousehold(job_.rubrica_id, job_.socio_id));
        book_.run(creditOfRelatives(job_.rubrica_id, job_.socio_id));
        book_.run(groupCreditOfPerson(main, job_.codABC, job_.socio_id));
        book_.run(groupCreditOfHousehold(main, job_.socio_id));
        book_.run(groupCreditOfRelatives(main, job_.socio_id));
        book_.run(rubric(main));
        if (!job_.isBill) book_.run(balance(job_.socio_id));
        if (hasFranchise) book_.run(franchise(job_.socio_id, job_.rubrica_id));
    }

    /// Holds a row while it is looked at and, where there is something to store, changed.
    Row held(const QByteArray& row, const QString& look, const QString& store = {}) {
        book_.hold(row);
        const Row found = book_.run(look);
        if (!store.isEmpty()) book_.run(store);
        book_.letGo(row);
        return found;
    }

    QByteArray accumulatorKey() const {
        return u"a%1 %2 %3"_s.arg(job_.socio_id).arg(job_.codABC).arg(job_.rubrica_id).toUtf8();
    }
    QString accumulator() const {
        return coverage::queries::accumulator(job_.rubrica_id, job_.socio_id, job_.codABC);
    }
    Row lookUpAccumulator() { return held(accumulatorKey(), accumulator()); }

    void takeCheque() {
        held("cheques", u"Select * from tbCheques"_s);
        held("cheques", u"Select * from tbCheques"_s,
             u"UPDATE tbCheques SET cheque_no = cheque_no + 1"_s);
    }

    int drawNumber() {
        return held("contadores", u"select * from tbContadores"_s,
                    u"UPDATE tbContadores SET zelmars = zelmars + 1"_s)[0]
            .toInt();
    }

    void save(int number) {
        book_.run(
            u"INSERT INTO tbZelmar_Movimentos (movimento_no, socio_id, codABC, rubrica_id, data, "
            "tipo, doc_data, doc_no, doc_valor, recebido, incidencia, comparticipacao, "
            "saldo_plafond, saldo_acumulado, iliquido, liquido, credito, debito, modo_pagamento, "
            "created_by) VALUES (%1, %2, '%3', %4, '2026-11-20 00:00:00', 'DOC', "
            "'2026-11-20 00:00:00', '%5', %6, 0, %6, %6, 0, 0, %6, %6, %6, %6, 'TRF', 'ana')"_s
                .arg(number)
                .arg(job_.socio_id)
                .arg(job_.codABC)
                .arg(job_.rubrica_id)
                .arg(document_)
                .arg(static_cast<double>(job_.cents) / 100));
    }

    void addToAccumulator() {
        held(accumulatorKey(), accumulator(),
             u"UPDATE tbSocios_Acumulados SET credito_ac = credito_ac + %1, debito_ac = "
             "debito_ac + %1, no_docs = no_docs + 1 WHERE rubrica_id = %2 AND socio_id = %3 AND "
             "codABC = '%4'"_s.arg(static_cast<double>(job_.cents) / 100)
                 .arg(job_.rubrica_id)
                 .arg(job_.socio_id)
                 .arg(job_.codABC));
    }

    BareBook& book_;
    office::Job job_;
    QString document_;
};

}  // namespace

int main(int, char** argv) {
    const int workstation = std::atoi(argv[1]);
    const int postings = std::atoi(argv[2]);
    const std::unique_ptr<BareBook> book = openBook();
    std::printf("ready\n");
    std::fflush(stdout);
    if (std::getchar() == EOF) return 3;
    QElapsedTimer clock;
    for (int number = 1; number <= postings; ++number) {
        clock.start();
        Posting(*book, office::jobOf(workstation, number),
                office::documentNumber(workstation, number))
            .run();
        std::printf("%d %lld\n", number, clock.nsecsElapsed() / 1000);
        std::fflush(stdout);
    }
}
