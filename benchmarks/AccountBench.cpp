// SPDX-License-Identifier: MIT
// Receipts and annulments at the level of the rules, against the bare engine that runs the same
// queries with the same locks.
#include "benchmarks/Bare.h"
#include "benchmarks/Benches.h"
#include "boundary/environment/dtZelmars.h"
#include "coverage/annulment.h"
#include "data/NewMovement.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "receipts/receipt.h"

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

core::Answer yes(const QString&, core::Icon, const QString&, core::Buttons buttons) {
    return buttons == core::Buttons::Ok ? core::Answer::Ok : core::Answer::Yes;
}

/// Documents in force, as a screen shows them; each can be annulled once.
ado::RecordsetPtr documents() {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(
        u"SELECT * FROM vwZelmars_Movimentos_Vigor WHERE tipo = 'DOC' AND ficheiro = 'ACTIVO' "
        "ORDER BY movimento_id DESC"_s,
        environment::dtZelmars::instance().MSAccess(), ado::adOpenStatic, ado::adLockOptimistic,
        ado::adCmdUnknown);
    return rows;
}

void runReceipt(qint32 socio_id) {
    QString connection;
    QString query;
    const ado::RecordsetPtr row = data::openNewMovement(connection, query);
    row->AddNew();
    row->setCollect(u"data"_s, QDateTime(QDate(2026, 11, 20), QTime(0, 0), Qt::UTC));
    row->setCollect(u"tipo"_s, u"PAG"_s);
    row->setCollect(u"modo_pagamento"_s, u"CHQ"_s);
    row->setCollect(u"credito"_s, 40);
    data::Operation operation;
    receipts::postReceipt({row, socio_id, u"Medição"_s, u"CHQ"_s, u"1"_s, u"40"_s}, operation);
}

/// Finds a row, holds it, reads it as it is then, writes it and lets it go. Gives its first column
/// as it was before.
double writeHeld(Bare& bare, const QByteArray& row, const QByteArray& select,
                 const QByteArray& update, const Bare::Values& values) {
    bare.run(select, values);
    const double first = bare.runLocked(row, Bare::Lock::Hold, select, values);
    bare.runLocked(row, Bare::Lock::LetGo, update, values);
    return first;
}

qint64 drawNumber(Bare& bare) {
    return static_cast<qint64>(writeHeld(bare, "counter", "SELECT zelmars FROM tbContadores",
                                         "UPDATE tbContadores SET zelmars = zelmars + 1", {}));
}

void runBareReceipt(Bare& bare, qint32 socio_id) {
    const qint64 member = socio_id;
    bare.run("SELECT * FROM tbZelmar_Movimentos WHERE movimento_id = 0");
    bare.run(
        "INSERT INTO tbZelmar_Movimentos (movimento_no, socio_id, data, tipo, modo_pagamento, "
        "doc_valor, debito, credito) VALUES ($1, $2, '2026-11-20 00:00:00', 'PAG', 'CHQ', 0, 0, "
        "40)",
        {drawNumber(bare), member});
    writeHeld(bare, "accumulator",
              "SELECT * FROM tbSocios_Acumulados WHERE socio_id = $1 AND rubrica_id_main = 0",
              "UPDATE tbSocios_Acumulados SET credito_ac = credito_ac + 40 WHERE socio_id = $1 AND "
              "rubrica_id_main = 0",
              {member});
}

void runBareAnnulment(Bare& bare, const ado::Recordset& shown) {
    const auto number = [&](const QString& column) {
        return qint64{core::toLong(shown.Collect(column))};
    };
    const QByteArray person = core::toText(shown.Collect(u"codABC"_s)).toUtf8();
    const qint64 member = number(u"socio_id"_s);
    const qint64 rubric = number(u"rubrica_id"_s);
    writeHeld(bare, "movement", "SELECT * FROM tbZelmar_Movimentos WHERE movimento_id = $1",
              "UPDATE tbZelmar_Movimentos SET tipo = 'ANL', modo_pagamento = 'ANL' WHERE "
              "movimento_id = $1",
              {number(u"movimento_id"_s)});
    bare.run(
        "INSERT INTO tbZelmar_Movimentos (movimento_no, socio_id, codABC, rubrica_id, data, tipo, "
        "doc_no, doc_data, doc_valor, credito, debito) VALUES ($1, $2, $3, $4, '2026-11-20 "
        "00:00:00', 'COR', '1234', '2026-11-20 00:00:00', 40, -28, -28)",
        {drawNumber(bare), member, person.constData(), rubric});
    writeHeld(
        bare, "accumulator",
        "SELECT * FROM tbSocios_Acumulados WHERE rubrica_id = $1 AND socio_id = $2 AND codABC "
        "= $3",
        "UPDATE tbSocios_Acumulados SET credito_ac = credito_ac - 28, debito_ac = debito_ac "
        "- 28, no_docs = no_docs - 1 WHERE rubrica_id = $1 AND socio_id = $2 AND codABC = $3",
        {rubric, member, person.constData()});
}

void measureOn(Report& report, Engine engine) {
    const QString receipt = u"receipt/"_s + nameOf(engine);
    const QString annulment = u"annulment/"_s + nameOf(engine);
    if (!report.wanted(receipt) && !report.wanted(annulment)) return;
    const BookCopy copy(sampleBook(engine));
    use(copy.book());
    const std::unique_ptr<Bare> alone = bare(copy.book());
    const qint32 member = usedCases(sampleBook(), 1).front().socio_id;
    runReceipt(member);  // adds the account-level row
    const ado::RecordsetPtr shown = documents();
    report.pair(
        receipt, 1.5, 20, [&] { runReceipt(member); }, [&] { runBareReceipt(*alone, member); });
    report.pair(
        annulment, 1.5, 20,
        [&] {
            data::Operation operation;
            shown->MoveNext();
            coverage::annul({shown, u"Medição"_s}, operation);
        },
        [&] { runBareAnnulment(*alone, *shown); });
}

}  // namespace

void measureAccounts(Report& report) {
    core::setMsgBoxPresenter(yes);
    measureOn(report, Engine::Sqlite);
    measureOn(report, Engine::Postgres);
}

}  // namespace benchmarks
