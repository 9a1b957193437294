// SPDX-License-Identifier: MIT
#include "tests/coverage/Desk.h"

#include "boundary/environment/dtZelmars.h"
#include "data/NewMovement.h"
#include "platform/com/Component.h"
#include "platform/core/Clock.h"
#include "platform/core/UserName.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

void reopen(const ado::ConnectionPtr& connection, const QString& text) {
    if (connection->State() == ado::adStateOpen) connection->Close();
    connection->ConnectionString = text;
    // Long enough for the work at hand, short enough for a test of somebody else's lock.
    connection->CommandTimeout = 1;
    connection->Open();
}

}  // namespace

const QString Desk::caption = u"Lançamento (Plano de Saúde)"_s;

Desk::Desk() : socio(static_cast<qint32>(book.member({}))) {
    com::registerRunning(u"Vorlane.General"_s, [] { return new FakeVorlane; });
    core::setToday(QDate(2026, 5, 15));
    core::setUserName("operador");
    auto& environment = environment::dtZelmars::instance();
    reopen(environment.MSAccess(), book.connectionString());
    reopen(environment.SqlServer(), book.shapingConnectionString());
}

Desk::~Desk() {
    auto& environment = environment::dtZelmars::instance();
    environment.MSAccess()->Close();
    environment.SqlServer()->Close();
    com::registerRunning(u"Vorlane.General"_s, {});
    core::setUserName({});
    core::setToday({});
}

coverage::Document Desk::enter(const Document& document) const {
    const ado::RecordsetPtr row = ado::Recordset::create();
    row->Open(data::NoMovementQuery.toString(), environment::dtZelmars::instance().MSAccess(),
              ado::adOpenStatic, ado::adLockPessimistic, ado::adCmdUnknown);
    row->AddNew();
    const QVariant& ninth = document.hospital ? document.incidencia : document.recebido;
    const std::pair<QString, QVariant> columns[] = {
        {u"data"_s, core::fromDate(core::today())},
        {u"tipo"_s, document.hospital ? u"HOS"_s : u"DOC"_s},
        {u"codABC"_s, document.codABC},
        {u"rubrica_id"_s, document.rubrica_id},
        {u"doc_valor"_s, document.doc_valor},
        {document.hospital ? u"incidencia"_s : u"recebido"_s, ninth},
    };
    for (const auto& [column, value] : columns) row->setCollect(column, value);
    return {.record = row,
            .socio_id = socio,
            .isHospital = document.hospital,
            .caption = caption,
            .personCode = document.codABC,
            .documentValue = core::toText(document.doc_valor),
            .receivedOrIncidence = core::toText(ninth),
            .rubric = u"01  -  Consultas"_s,
            .rubrica_id = document.rubrica_id};
}

coverage::Posting Desk::posting(const coverage::Document& entry) {
    return {.document = entry,
            .paymentMode = u"TRF - Transferência"_s,
            .modo_pagamento = u"TRF"_s,
            .movementDate = u"15-05-2026"_s,
            .documentDate = u"12-05-2026"_s,
            .documentNumber = u"FT 1/77"_s,
            .hospital = entry.isHospital ? u"H01 - Hospital da Luz Nova"_s : QString(),
            .askCheque = [](const ado::RecordsetPtr&) { ADD_FAILURE() << "no cheque wanted"; }};
}

bool Desk::post(const coverage::Posting& posting, const QList<support::Operator::Box>& boxes) {
    person.expectBox({.text = u"Deseja finalizar o registo?"_s,
                      .answer = core::Answer::Yes,
                      .icon = core::Icon::Question,
                      .title = caption});
    for (const support::Operator::Box& box : boxes) person.expectBox(box);
    begun = {};
    const bool posted = coverage::post(posting, run, begun);
    person.expectNoBoxesLeft();
    return posted;
}

void Desk::accumulated(const QString& codABC, qint64 rubrica_id, double credit, int documents) {
    book.exec(
        u"insert into tbSocios_Acumulados (socio_id, codABC, rubrica_id, rubrica_id_main, "
        "debito_ac, credito_ac, no_docs) select %1, '%2', rubrica_id, rubrica_id_main, %3, %3, %4 "
        "from tbZelmar_Plafonds where rubrica_id = %5"_s.arg(socio)
            .arg(codABC)
            .arg(credit)
            .arg(documents)
            .arg(rubrica_id));
}

void Desk::moved(qint64 rubrica_id, const QVariant& liquido, const QVariant& credito,
                 const QString& tipo) {
    book.insert(u"tbZelmar_Movimentos"_s, {{"socio_id", socio},
                                           {"rubrica_id", rubrica_id},
                                           {"codABC", u"C9"_s},
                                           {"tipo", tipo},
                                           {"liquido", liquido},
                                           {"credito", credito}});
}

void Desk::setRubric(qint64 rubrica_id, const char* column, const QVariant& value) {
    book.exec(
        u"update tbZelmar_Plafonds set %1 = %2 where rubrica_id = %3"_s
            .arg(QLatin1StringView(column), core::isNull(value) ? u"null"_s : core::toText(value))
            .arg(rubrica_id));
}

std::string Desk::kept(const coverage::Document& entry, const char* column) {
    const QVariant value = entry.record->Collect(QString::fromLatin1(column));
    return core::isNull(value) ? "null" : core::toText(value).toStdString();
}
