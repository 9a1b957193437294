// SPDX-License-Identifier: MIT
// Try-out and posting at the level of the rules, against the bare engine that prepares and runs the
// same queries with the same settings.
#include <optional>

#include "benchmarks/Bare.h"
#include "benchmarks/Benches.h"
#include "benchmarks/Books.h"
#include "boundary/environment/dtZelmars.h"
#include "coverage/Posting.h"
#include "coverage/Queries.h"
#include "platform/core/MsgBox.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

/// Takes cases in turn, for ever.
class Turn {
public:
    explicit Turn(std::vector<Case> cases) : cases_(std::move(cases)) {}
    const Case& next() { return cases_[at_++ % cases_.size()]; }

private:
    std::vector<Case> cases_;
    std::size_t at_ = 0;
};

core::Answer yes(const QString&, core::Icon, const QString&, core::Buttons buttons) {
    return buttons == core::Buttons::Ok ? core::Answer::Ok : core::Answer::Yes;
}

ado::RecordsetPtr pendingRow() {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(u"select * from tbzelmar_movimentos where movimento_id = 0"_s,
               environment::dtZelmars::instance().MSAccess(), ado::adOpenStatic,
               ado::adLockPessimistic, ado::adCmdUnknown);
    rows->AddNew();
    const QDateTime day(QDate(2026, 11, 20), QTime(0, 0), Qt::UTC);
    rows->setCollect(u"data"_s, day);
    rows->setCollect(u"tipo"_s, u"DOC"_s);
    rows->setCollect(u"doc_data"_s, day);
    rows->setCollect(u"doc_no"_s, u"1234"_s);
    rows->setCollect(u"doc_valor"_s, 40);
    rows->setCollect(u"recebido"_s, 0);
    rows->setCollect(u"modo_pagamento"_s, u"TRF"_s);
    return rows;
}

coverage::Document documentFor(const Case& of, const ado::RecordsetPtr& record) {
    record->setCollect(u"codABC"_s, of.codABC);
    record->setCollect(u"rubrica_id"_s, of.rubrica_id);
    return {.record = record,
            .socio_id = of.socio_id,
            .caption = u"Medição"_s,
            .personCode = of.codABC,
            .documentValue = u"40"_s,
            .receivedOrIncidence = u"0"_s,
            .rubric = u"rúbrica"_s,
            .rubrica_id = of.rubrica_id};
}

void runTryOut(const Case& of, const ado::RecordsetPtr& record) {
    coverage::TryOut run;
    coverage::tryOut(documentFor(of, record), run);
}

constexpr auto Rubric = "SELECT * FROM tbZelmar_Plafonds WHERE rubrica_id = $1";
constexpr auto Accumulator =
    "SELECT * FROM tbSocios_Acumulados WHERE rubrica_id = $1 AND socio_id = $2 AND codABC = $3";
constexpr auto CreditOfHousehold =
    "SELECT sum(credito_ac) FROM tbSocios_Acumulados WHERE rubrica_id = $1 AND socio_id = $2";
constexpr auto CreditOfRelatives =
    "SELECT sum(credito_ac) FROM tbSocios_Acumulados WHERE rubrica_id = $1 AND socio_id = $2 AND "
    "codABC <> 'A'";
constexpr auto GroupCreditOfPerson =
    "SELECT sum(credito_ac) FROM tbSocios_Acumulados WHERE rubrica_id_main = $1 AND socio_id = $2 "
    "AND codABC = $3";
constexpr auto GroupCreditOfHousehold =
    "SELECT sum(credito_ac) FROM tbSocios_Acumulados WHERE rubrica_id_main = $1 AND socio_id = $2";
constexpr auto GroupCreditOfRelatives =
    "SELECT sum(credito_ac) FROM tbSocios_Acumulados WHERE rubrica_id_main = $1 AND socio_id = $2 "
    "AND codABC <> 'A'";
constexpr auto Balance =
    "SELECT sum(debito_ac), sum(credito_ac) FROM tbSocios_Acumulados WHERE socio_id = $1";

/// Looks a row up as a pessimistic row set does: finds it, holds it, reads it as it is then, and
/// lets it go.
void lookUpHeld(Bare& bare, const QByteArray& row, const QByteArray& query,
                const Bare::Values& values) {
    bare.run(query, values);
    bare.runLocked(row, Bare::Lock::Both, query, values);
}

/// The queries and locks of one try-out.
void runBareTryOut(Bare& bare, const Case& of) {
    const qint64 rubric = of.rubrica_id;
    const qint64 member = of.socio_id;
    const QByteArray person = of.codABC.toUtf8();
    const Bare::Values own{rubric, member, person.constData()};
    const auto main = static_cast<qint64>(bare.run(Rubric, {rubric}, 1));
    lookUpHeld(bare, "accumulator", Accumulator, own);
    lookUpHeld(bare, "accumulator", Accumulator, own);
    bare.run(CreditOfHousehold, {rubric, member});
    bare.run(CreditOfRelatives, {rubric, member});
    bare.run(GroupCreditOfPerson, {main, member, person.constData()});
    bare.run(GroupCreditOfHousehold, {main, member});
    bare.run(GroupCreditOfRelatives, {main, member});
    bare.run(Rubric, {main});
    bare.run(Balance, {member});
}

/// What a posting adds to its try-out. It keeps no journal of operations, as ours does.
void runBarePosting(Bare& bare, const Case& of) {
    runBareTryOut(bare, of);
    const qint64 member = of.socio_id;
    const QByteArray person = of.codABC.toUtf8();
    const Bare::Values own{qint64{of.rubrica_id}, member, person.constData()};
    bare.run("SELECT * FROM tbSocios WHERE socio_id = $1", {member});
    const QByteArray counter = "SELECT zelmars FROM tbContadores";
    bare.run(counter);
    const auto number = static_cast<qint64>(bare.runLocked("counter", Bare::Lock::Hold, counter));
    bare.runLocked("counter", Bare::Lock::LetGo, "UPDATE tbContadores SET zelmars = $1",
                   {number + 1});
    bare.run(
        "INSERT INTO tbZelmar_Movimentos (movimento_no, socio_id, codABC, rubrica_id, data, tipo, "
        "doc_data, doc_no, doc_valor, recebido, incidencia, comparticipacao, saldo_plafond, "
        "saldo_acumulado, iliquido, liquido, credito, debito, modo_pagamento, created_by) VALUES "
        "($1, $2, $3, $4, '2026-11-20 00:00:00', 'DOC', '2026-11-20 00:00:00', '1234', 40, 0, 40, "
        "28, 100, 0, 28, 28, 28, 28, 'TRF', 'ana')",
        {number, member, person.constData(), qint64{of.rubrica_id}});
    bare.run(Accumulator, own);
    bare.runLocked("accumulator", Bare::Lock::Hold, Accumulator, own);
    bare.runLocked(
        "accumulator", Bare::Lock::LetGo,
        "UPDATE tbSocios_Acumulados SET credito_ac = credito_ac + 28, debito_ac = debito_ac + "
        "28, no_docs = no_docs + 1 WHERE rubrica_id = $1 AND socio_id = $2 AND codABC = $3",
        own);
}

void runPosting(const Case& of) {
    const coverage::Posting posting{.document = documentFor(of, pendingRow()),
                                    .paymentMode = u"TRF - Transferência"_s,
                                    .modo_pagamento = u"TRF"_s,
                                    .movementDate = u"20-11-2026"_s,
                                    .documentDate = u"20-11-2026"_s,
                                    .documentNumber = u"1234"_s};
    coverage::TryOut run;
    data::Operation operation;
    coverage::post(posting, run, operation);
}

/// The same try-outs on both books, in turn, so that the machine's moods fall on both alike. A
/// fresh case adds its accumulator row.
void compareBooks(Report& report, const QString& name, bool fresh) {
    if (!report.wanted(name)) return;
    const BookCopy copies[] = {BookCopy(largeBook()), BookCopy(sampleBook())};
    std::optional<Turn> turns[2];
    for (int at : {0, 1})
        turns[at].emplace(fresh ? freshCases(copies[at].book(), 2000)
                                : usedCases(copies[at].book(), 500));
    std::vector<double> times[2];
    for (int round = 0; round < 15; ++round)
        for (int turn : {0, 1}) {
            // Each of the two goes first in turn, so that neither always finds what the other left
            // in memory.
            const int at = (round + turn) % 2;
            use(copies[at].book());
            const ado::RecordsetPtr record = pendingRow();
            times[at].push_back(
                report.median(fresh ? 20 : 100, [&] { runTryOut(turns[at]->next(), record); }));
        }
    report.ratio(name, 1.3, times[0], times[1]);
}

/// On a fresh copy, which both write to alike.
void compareWithBare(Report& report, const QString& name, double limit, Engine engine, int calls,
                     const std::function<void(const Case&)>& ours,
                     const std::function<void(Bare&, const Case&)>& theirs) {
    if (!report.wanted(name)) return;
    const std::vector<Case> cases = usedCases(sampleBook(), 500);
    const BookCopy copy(sampleBook(engine));
    use(copy.book());
    const std::unique_ptr<Bare> engineAlone = bare(copy.book());
    Turn ourTurn(cases);
    Turn theirTurn(cases);
    report.pair(
        name, limit, calls, [&] { ours(ourTurn.next()); },
        [&] { theirs(*engineAlone, theirTurn.next()); });
}

void measureHeavyMembers(Report& report, Engine engine) {
    const auto row = [&](const QString& what, double limit, const Case& of) {
        const QString name = u"try-out, member with %1, %2"_s.arg(what, nameOf(engine));
        if (!report.wanted(name)) return;
        use(heavyBook(engine));
        const ado::RecordsetPtr record = pendingRow();
        report.value(name, u"ms"_s, limit, report.medianOf(15, [&] {
            return report.median(5, [&] { runTryOut(of, record); });
        }));
    };
    row(u"50,000 movements"_s, 5, {MemberOfMovements, u"A"_s, FranchiseRubric});
    row(u"6,000 accumulators"_s, 2, {MemberOfAccumulators, u"A"_s, FranchiseRubric});
}

}  // namespace

void measureCoverage(Report& report) {
    core::setMsgBoxPresenter(yes);
    for (const Engine engine : {Engine::Sqlite, Engine::Postgres}) {
        const QString on = u'/' + nameOf(engine);
        const double limit = engine == Engine::Sqlite ? 1.5 : 1.3;
        ado::RecordsetPtr record;
        const auto tryOut = [&](const Case& of) {
            if (!record) record = pendingRow();
            runTryOut(of, record);
        };
        compareWithBare(report, u"try-out"_s + on, limit, engine, 200, tryOut, runBareTryOut);
        measureHeavyMembers(report, engine);
        compareWithBare(report, u"posting"_s + on, limit, engine, 20, runPosting, runBarePosting);
    }
    compareBooks(report, u"large-book/try-out"_s, false);
    compareBooks(report, u"large-book/first try-out of a person"_s, true);
}

}  // namespace benchmarks
