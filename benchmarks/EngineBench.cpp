// SPDX-License-Identifier: MIT
// The row-set layer on both engines against the engines' client libraries alone: long passes, many
// writes, opening, locks.
#include <QElapsedTimer>
#include <QFile>
#include <optional>

#include "benchmarks/Bare.h"
#include "benchmarks/Benches.h"
#include "platform/ado/Recordset.h"
#include "platform/ado/engine/RowStore.h"
#include "platform/core/Money.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

constexpr int Rounds = 5;
constexpr int Inserts = 100'000;
constexpr int Updates = 98'000;  // each tenth of all movements of this year
/// Stretches that a long run of writes is measured in, ours and the bare ones in turn.
constexpr int Stretches = 10;

// All 1,000,000 movements stand in these two.
const QString Movements[] = {u"select * from tbZelmar_Movimentos"_s,
                             u"select * from tbZelmar_Movimentos_Inactivos"_s};

/// The columns that a pass uses, by their places in the table.
enum Column { Id = 0, Socio = 2, Data = 7, Tipo = 8, Credito = 21, Debito = 22 };

ado::ConnectionPtr connect(const Book& book) {
    auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString = book.connectionString();
    connection->Open();
    return connection;
}

ado::RecordsetPtr open(const QString& query, const ado::ConnectionPtr& connection,
                       ado::LockType lock = ado::adLockReadOnly) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(query, connection, ado::adOpenStatic, lock, ado::adCmdUnknown);
    return rows;
}

double milliseconds(const std::function<void()>& work) {
    QElapsedTimer clock;
    clock.start();
    work();
    return static_cast<double>(clock.nsecsElapsed()) / 1e6;
}

double residentMegabytes() {
    QFile status(u"/proc/self/statm"_s);
    if (!status.open(QIODevice::ReadOnly)) return 0;
    return status.readAll().split(' ').value(1).toDouble() * 4096 / 1048576;
}

// --- Reading

/// What a pass found; the same on both sides.
struct Seen {
    qint64 rows = 0;
    qint64 members = 0;
    double balance = 0;
    qint64 letters = 0;
    /// A server gives the rows in any order, so that the sums differ in their last digits.
    bool operator==(const Seen& other) const {
        return rows == other.rows && members == other.members && letters == other.letters &&
               std::abs(balance - other.balance) < 0.01;
    }
};

/// @param most  the memory that was in use at any time, in MB; null when nobody asks
Seen pass(const ado::ConnectionPtr& connection, double* most) {
    Seen seen;
    for (const QString& query : Movements) {
        const ado::RecordsetPtr rows = open(query, connection);
        for (; !rows->atEnd(); rows->MoveNext()) {
            seen.members += rows->value(Socio).toInt();
            seen.letters += rows->value(Data).isValid();
            seen.letters += rows->value(Tipo).toString().size();
            seen.balance += rows->value(Debito).value<core::Money>().toDouble();
            seen.balance -= rows->value(Credito).value<core::Money>().toDouble();
            if (++seen.rows % 10'000 == 0 && most) *most = std::max(*most, residentMegabytes());
        }
    }
    return seen;
}

Seen barePass(Bare& bare) {
    Seen seen;
    for (const QString& query : Movements) {
        const std::unique_ptr<BareRows> rows = bare.rows(query.toUtf8());
        for (; rows->next(); ++seen.rows) {
            seen.members += rows->integer(Socio);
            seen.letters += rows->text(Data)[0] != '\0';
            seen.letters += static_cast<qint64>(qstrlen(rows->text(Tipo)));
            seen.balance += rows->real(Debito);
            seen.balance -= rows->real(Credito);
        }
    }
    return seen;
}

void measurePass(Report& report, Engine engine) {
    const QString on = u'/' + nameOf(engine);
    const QString name = u"pass, 1,000,000 rows"_s + on;
    if (!report.wanted(name)) return;
    const Book large = largeBook(engine);
    const ado::ConnectionPtr connection = connect(large);
    const std::unique_ptr<Bare> engineAlone = bare(large);
    const double start = residentMegabytes();
    double most = start;
    if (pass(connection, &most).rows != 1'000'000) throw std::runtime_error("rows are missing");
    std::vector<double> ours, theirs;
    for (int round = 0; round < Rounds; ++round) {
        Seen seen;
        ours.push_back(milliseconds([&] { seen = pass(connection, nullptr); }));
        theirs.push_back(milliseconds([&] {
            if (barePass(*engineAlone) != seen) throw std::runtime_error("the passes differ");
        }));
    }
    report.ratio(name, 1.5, ours, theirs);
    report.value(name + u", memory"_s, u"MB"_s, 64, most - start);
}

// --- Writing

/// Runs both in turn, one stretch each.
void compareStretches(Report& report, const QString& name, const std::function<void()>& ours,
                      const std::function<void()>& theirs) {
    std::vector<double> ourTimes, theirTimes;
    for (int stretch = 0; stretch < Stretches; ++stretch) {
        ourTimes.push_back(milliseconds(ours));
        theirTimes.push_back(milliseconds(theirs));
    }
    report.ratio(name, 1.5, ourTimes, theirTimes);
}

void fillDocument(ado::Recordset& row, int number) {
    const QDateTime day(QDate(2026, 11, 20), QTime(0, 0), Qt::UTC);
    row.setCollect(u"movimento_no"_s, number);
    row.setCollect(u"socio_id"_s, 17);
    row.setCollect(u"codABC"_s, u"A"_s);
    row.setCollect(u"rubrica_id"_s, 5);
    row.setCollect(u"data"_s, day);
    row.setCollect(u"tipo"_s, u"DOC"_s);
    row.setCollect(u"doc_data"_s, day);
    row.setCollect(u"doc_no"_s, u"1234"_s);
    for (const auto& column : {u"doc_valor"_s, u"recebido"_s, u"incidencia"_s, u"comparticipacao"_s,
                               u"iliquido"_s, u"liquido"_s, u"credito"_s, u"debito"_s})
        row.setCollect(column, 28.5);
    row.setCollect(u"modo_pagamento"_s, u"TRF"_s);
    row.setCollect(u"created_by"_s, u"ana"_s);
}

void insertBare(Bare& bare, qint64 number) {
    const BareValue amount = 28.5;
    const char* const day = "2026-11-20 00:00:00";
    bare.run(
        "INSERT INTO tbZelmar_Movimentos (movimento_no, socio_id, codABC, rubrica_id, data, tipo, "
        "doc_data, doc_no, doc_valor, recebido, incidencia, comparticipacao, iliquido, liquido, "
        "credito, debito, modo_pagamento, created_by) VALUES ($1, $2, $3, $4, $5, $6, $7, $8, $9, "
        "$10, $11, $12, $13, $14, $15, $16, $17, $18)",
        {number, qint64{17}, "A", qint64{5}, day, "DOC", day, "1234", amount, amount, amount,
         amount, amount, amount, amount, amount, "TRF", "ana"});
}

/// How many of so many writes are done in about half a minute, at least a hundredth: where each
/// commit waits for a slow disk, all of them would take too long.
int affordable(Bare& bare, int wanted) {
    constexpr int Tried = 100;
    constexpr double Most = 30'000;  // milliseconds
    const double each = milliseconds([&] {
                            for (int number = 0; number < Tried; ++number) insertBare(bare, number);
                        }) /
                        Tried;
    return std::clamp(static_cast<int>(Most / each), wanted / 100, wanted);
}

/// A measure's name, with the number of rows where they are fewer than it says.
QString withCount(const QString& name, int rows, int named) {
    return rows < named ? name + u", %1 of them"_s.arg(rows) : name;
}

/// Passes over a tenth of the table and writes to each tenth row of it.
void measureUpdates(Report& report, Engine engine) {
    const QString name = u"pass that updates each tenth row/"_s + nameOf(engine);
    if (!report.wanted(name)) return;
    const BookCopy copy(largeBook(engine));
    const std::unique_ptr<Bare> engineAlone = bare(copy.book());
    // The writes also make the book one at work: a pass that begins with an empty journal makes
    // every bare write slower.
    const int writes = affordable(*engineAlone, Updates);
    const int steps = writes / Stretches * 10;
    const ado::RecordsetPtr rows = open(Movements[0], connect(copy.book()), ado::adLockOptimistic);
    const std::unique_ptr<BareRows> theirRows = engineAlone->rows(Movements[0].toUtf8());
    const auto ours = [&] {
        for (int step = 1; step <= steps; ++step, rows->MoveNext()) {
            if (step % 10 != 0) continue;
            rows->setCollect(u"obs"_s, u"medida"_s);
            rows->Update();
        }
    };
    const auto theirs = [&] {
        for (int step = 1; step <= steps && theirRows->next(); ++step)
            if (step % 10 == 0)
                engineAlone->run("UPDATE tbZelmar_Movimentos SET obs = $1 WHERE movimento_id = $2",
                                 {"medido", theirRows->integer(Id)});
    };
    compareStretches(report, withCount(name, writes, Updates), ours, theirs);
}

void measureInserts(Report& report, Engine engine) {
    const QString name = u"100,000 new rows/"_s + nameOf(engine);
    if (!report.wanted(name)) return;
    const BookCopy copy(sampleBook(engine));
    const ado::RecordsetPtr rows =
        open(u"select * from tbzelmar_movimentos where movimento_id = 0"_s, connect(copy.book()),
             ado::adLockPessimistic);
    const std::unique_ptr<Bare> engineAlone = bare(copy.book());
    const int inserts = affordable(*engineAlone, Inserts);
    const auto ours = [&] {
        for (int number = 0; number < inserts / Stretches; ++number) {
            rows->AddNew();
            fillDocument(*rows, number);
            rows->Update();
        }
    };
    const auto theirs = [&] {
        for (int number = 0; number < inserts / Stretches; ++number)
            insertBare(*engineAlone, number);
    };
    compareStretches(report, withCount(name, inserts, Inserts), ours, theirs);
}

// --- Single rows

void measureOpening(Report& report, Engine engine) {
    const QString name = u"open a row set and add a row/"_s + nameOf(engine);
    if (!report.wanted(name)) return;
    const BookCopy copies[] = {BookCopy(largeBook(engine)), BookCopy(sampleBook(engine))};
    const ado::ConnectionPtr connections[] = {connect(copies[0].book()), connect(copies[1].book())};
    std::vector<double> times[2];
    for (int round = 0; round < 15; ++round)
        for (const int turn : {0, 1}) {
            const int at = (round + turn) % 2;
            times[at].push_back(report.median(50, [&] {
                const ado::RecordsetPtr rows =
                    open(Movements[0], connections[at], ado::adLockPessimistic);
                rows->AddNew();
                fillDocument(*rows, round);
                rows->Update();
                rows->Close();
            }));
        }
    report.ratio(name + u", against sample"_s, 1.3, times[0], times[1]);
    std::sort(times[0].begin(), times[0].end());
    report.value(name + u", large book"_s, u"ms"_s, 2, times[0][times[0].size() / 2]);
}

/// What the caller waits for: a row is held, read as it is then, and let go. On a server that is
/// held against the same queries in one round trip.
class LockPairs {
public:
    explicit LockPairs(const Book& book) : session_(connect(book)->session()), bare_(bare(book)) {}

    void run(int pairs, std::vector<double>& ours, std::vector<double>& theirs) {
        const auto own = [&] { session_->lock(Table, 1, 30, fresh_); };
        const auto other = [&] {
            bare_->runLocked("1", Bare::Lock::Both, "SELECT zelmars FROM tbContadores");
        };
        own();
        other();
        for (int pair = 0; pair < pairs; ++pair) {
            // Each of the two goes first in turn: the second one finds the memory filled.
            if (pair % 2 != 0) ours.push_back(settled(own));
            theirs.push_back(settled(other));
            if (pair % 2 == 0) ours.push_back(settled(own));
        }
    }

private:
    /// The time of some work. Waits until the server is idle again, so that what it still does for
    /// one of the two does not slow the other one down.
    double settled(const std::function<void()>& work) {
        const double time = milliseconds(work);
        fresh_.clear();
        session_->read(Table, 1, fresh_);
        return time;
    }

    static inline const QString Table = u"tbContadores"_s;
    std::shared_ptr<ado::Session> session_;
    std::unique_ptr<Bare> bare_;
    ado::RowStore fresh_;
};

void measureLock(Report& report, Engine engine) {
    const QString name = u"lock taken and released/"_s + nameOf(engine);
    if (!report.wanted(name)) return;
    // New connections again and again: where the system lets the server's process run decides more
    // than what it does.
    constexpr int Connections = 20;
    constexpr int Pairs = 50;
    std::vector<double> ours, theirs;
    for (int each = 0; each < Connections; ++each)
        LockPairs(sampleBook(engine)).run(Pairs, ours, theirs);
    if (engine == Engine::Postgres) return report.ratio(name, 1.5, ours, theirs);
    std::sort(ours.begin(), ours.end());
    report.value(name, u"µs"_s, 20, ours[ours.size() / 2] * 1000);
}

}  // namespace

void measureEngines(Report& report) {
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        measurePass(report, engine);
        measureUpdates(report, engine);
        measureInserts(report, engine);
        measureOpening(report, engine);
        measureLock(report, engine);
    }
}

}  // namespace benchmarks
