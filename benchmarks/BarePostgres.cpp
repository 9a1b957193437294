// SPDX-License-Identifier: MIT
#include <libpq-fe.h>

#include <QHash>
#include <cstdio>
#include <cstdlib>

#include "benchmarks/Bare.h"

namespace benchmarks {

namespace {

[[noreturn]] void stop(PGconn* connection, const QByteArray& query) {
    std::fprintf(stderr, "%s: %s\n", PQerrorMessage(connection), query.constData());
    std::exit(1);
}

PGconn* connect(const Book& book) {
    const ado::postgres::Address server = book.server();
    PGconn* connection = PQsetdbLogin(server.host.toUtf8().constData(), nullptr, nullptr, nullptr,
                                      server.catalog.toUtf8().constData(),
                                      server.user.toUtf8().constData(), nullptr);
    if (PQstatus(connection) != CONNECTION_OK) stop(connection, "connect");
    return connection;
}

PGresult* checked(PGconn* connection, PGresult* result, const QByteArray& query) {
    const ExecStatusType status = PQresultStatus(result);
    if (status != PGRES_COMMAND_OK && status != PGRES_TUPLES_OK) stop(connection, query);
    return result;
}

PGresult* run(PGconn* connection, const QByteArray& query) {
    return checked(connection, PQexec(connection, query.constData()), query);
}

class BarePostgresRows final : public BareRows {
public:
    BarePostgresRows(const Book& book, const QByteArray& query) : connection_(connect(book)) {
        PQclear(run(connection_, "BEGIN"));
        PQclear(run(connection_, "DECLARE c NO SCROLL CURSOR FOR " + query));
    }
    ~BarePostgresRows() override {
        PQclear(batch_);
        PQfinish(connection_);
    }

    bool next() override {
        if (++row_ < PQntuples(batch_)) return true;
        PQclear(batch_);
        batch_ = run(connection_, "FETCH 1000 FROM c");
        row_ = 0;
        return PQntuples(batch_) > 0;
    }
    qint64 integer(int column) const override { return std::atoll(text(column)); }
    double real(int column) const override { return std::strtod(text(column), nullptr); }
    const char* text(int column) const override { return PQgetvalue(batch_, row_, column); }

private:
    PGconn* connection_;
    PGresult* batch_ = nullptr;
    int row_ = 0;
};

class BarePostgres final : public Bare {
public:
    explicit BarePostgres(const Book& book) : book_(book), connection_(connect(book)) {}
    ~BarePostgres() override { PQfinish(connection_); }

    double run(const QByteArray& query, const Values& values, int column) override {
        const Call call(*this, query, values);
        PGresult* result = checked(connection_,
                                   PQexecPrepared(connection_, call.name.constData(), call.count(),
                                                  call.pointers.data(), nullptr, nullptr, 0),
                                   query);
        const double found =
            PQntuples(result) > 0 ? std::strtod(PQgetvalue(result, 0, column), nullptr) : 0;
        PQclear(result);
        return found;
    }

    double runLocked(const QByteArray& row, Lock lock, const QByteArray& query,
                     const Values& values) override {
        std::vector<Call> calls;
        if (lock != Lock::LetGo) calls.emplace_back(*this, Hold, Values{row.constData()});
        const std::size_t wanted = calls.size();
        calls.emplace_back(*this, query, values);
        if (lock != Lock::Hold) calls.emplace_back(*this, LetGo, Values{row.constData()});
        PQenterPipelineMode(connection_);
        for (const Call& call : calls)
            PQsendQueryPrepared(connection_, call.name.constData(), call.count(),
                                call.pointers.data(), nullptr, nullptr, 0);
        PQpipelineSync(connection_);
        double found = 0;
        for (std::size_t at = 0; at < calls.size(); ++at) {
            PGresult* result = checked(connection_, PQgetResult(connection_), query);
            if (at == wanted && PQntuples(result) > 0)
                found = std::strtod(PQgetvalue(result, 0, 0), nullptr);
            PQclear(result);
            PQgetResult(connection_);  // the end of its rows
        }
        PQclear(PQgetResult(connection_));
        PQexitPipelineMode(connection_);
        return found;
    }

    std::unique_ptr<BareRows> rows(const QByteArray& query) override {
        return std::make_unique<BarePostgresRows>(book_, query);
    }

private:
    static constexpr auto Hold = "SELECT pg_advisory_lock(hashtextextended($1, 1))";
    static constexpr auto LetGo = "SELECT pg_advisory_unlock(hashtextextended($1, 1))";

    /// A prepared statement with its values as the library takes them.
    struct Call {
        Call(BarePostgres& bare, const QByteArray& query, const Values& values)
            : name(bare.prepared(query)) {
            for (const BareValue& value : values) texts.push_back(textOf(value));
            for (const QByteArray& text : texts) pointers.push_back(text.constData());
        }
        int count() const { return static_cast<int>(pointers.size()); }

        QByteArray name;
        std::vector<QByteArray> texts;
        std::vector<const char*> pointers;
    };

    QByteArray prepared(const QByteArray& query) {
        QByteArray& name = names_[query];
        if (!name.isEmpty()) return name;
        name = 'b' + QByteArray::number(names_.size());
        PQclear(checked(connection_,
                        PQprepare(connection_, name.constData(), query.constData(), 0, nullptr),
                        query));
        return name;
    }

    static QByteArray textOf(const BareValue& value) {
        if (const auto* number = std::get_if<qint64>(&value)) return QByteArray::number(*number);
        if (const auto* real = std::get_if<double>(&value))
            return QByteArray::number(*real, 'g', 17);
        return QByteArray::fromRawData(std::get<const char*>(value),
                                       qstrlen(std::get<const char*>(value)));
    }

    Book book_;
    PGconn* connection_;
    QHash<QByteArray, QByteArray> names_;  ///< of prepared queries
};

}  // namespace

std::unique_ptr<Bare> barePostgres(const Book& book) {
    return std::make_unique<BarePostgres>(book);
}

}  // namespace benchmarks
