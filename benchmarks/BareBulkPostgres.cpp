// SPDX-License-Identifier: MIT
#include <libpq-fe.h>

#include <cstdio>
#include <cstdlib>

#include "benchmarks/BareBulk.h"

namespace benchmarks {

namespace {

constexpr int WritesOfACommit = 256;

[[noreturn]] void stop(PGconn* connection, const QByteArray& query) {
    std::fprintf(stderr, "%s: %s\n", PQerrorMessage(connection), query.constData());
    std::exit(1);
}

class BareBulkPostgres final : public BareBulk {
public:
    explicit BareBulkPostgres(const Book& book) : book_(book), writer_(connect()) {
        run(writer_, "SET synchronous_commit = off");
        run(writer_, "SET jit = off");
    }
    ~BareBulkPostgres() override { PQfinish(writer_); }

    void each(const QByteArray& query, const std::vector<BareWrite>& writes) override {
        PGconn* const reader = connect();
        run(reader, "SET jit = off");
        run(reader, "BEGIN");
        run(reader, "DECLARE c NO SCROLL CURSOR FOR " + query);
        int number = 0;
        for (const BareWrite& write : writes)
            PQclear(checked(writer_, PQprepare(writer_, name(number++), write.text, 0, nullptr)));
        PQenterPipelineMode(writer_);
        for (PGresult* rows = run(reader, "FETCH 1000 FROM c"); PQntuples(rows) > 0;
             PQclear(rows), rows = run(reader, "FETCH 1000 FROM c"))
            for (int row = 0; row < PQntuples(rows); ++row) send(rows, row, writes);
        synchronise();
        PQexitPipelineMode(writer_);
        run(writer_, "DEALLOCATE ALL");
        PQfinish(reader);
    }

    qint64 read(const QByteArray& query) override {
        PQclear(PQexec(writer_, "COPY (" + query + ") TO STDOUT"));
        qint64 count = 0;
        char* line = nullptr;
        for (; PQgetCopyData(writer_, &line, 0) > 0; ++count) PQfreemem(line);
        PQclear(checked(writer_, PQgetResult(writer_)));
        PQclear(PQgetResult(writer_));
        return count;
    }

    void finish() override {
        run(writer_, "SET synchronous_commit = on");
        run(writer_, "CREATE TEMPORARY TABLE last (x integer)");
    }

private:
    static QByteArray name(int number) { return 'w' + QByteArray::number(number); }

    void send(const PGresult* rows, int row, const std::vector<BareWrite>& writes) {
        int number = 0;
        for (const BareWrite& write : writes) {
            const char* values[64];
            int count = 0;
            for (const int column : write.columns)
                values[count++] =
                    PQgetisnull(rows, row, column) ? nullptr : PQgetvalue(rows, row, column);
            PQsendQueryPrepared(writer_, name(number++), count, values, nullptr, nullptr, 0);
            if (++sent_ >= WritesOfACommit) synchronise();
        }
    }
    void synchronise() {
        PQpipelineSync(writer_);
        for (; sent_ > 0; --sent_) {
            PQclear(checked(writer_, PQgetResult(writer_)));
            PQgetResult(writer_);  // the end of its rows
        }
        PQclear(PQgetResult(writer_));
    }
    PGconn* connect() const {
        const ado::postgres::Address server = book_.server();
        PGconn* connection = PQsetdbLogin(server.host.toUtf8().constData(), nullptr, nullptr,
                                          nullptr, server.catalog.toUtf8().constData(),
                                          server.user.toUtf8().constData(), nullptr);
        if (PQstatus(connection) != CONNECTION_OK) stop(connection, "connect");
        return connection;
    }
    static PGresult* checked(PGconn* connection, PGresult* result) {
        const ExecStatusType status = PQresultStatus(result);
        if (status != PGRES_COMMAND_OK && status != PGRES_TUPLES_OK) stop(connection, "write");
        return result;
    }
    static PGresult* run(PGconn* connection, const QByteArray& query) {
        PGresult* const result = PQexec(connection, query);
        const ExecStatusType status = PQresultStatus(result);
        if (status != PGRES_COMMAND_OK && status != PGRES_TUPLES_OK) stop(connection, query);
        return result;
    }

    Book book_;
    PGconn* writer_;
    int sent_ = 0;
};

}  // namespace

std::unique_ptr<BareBulk> bareBulkPostgres(const Book& book) {
    return std::make_unique<BareBulkPostgres>(book);
}

}  // namespace benchmarks
