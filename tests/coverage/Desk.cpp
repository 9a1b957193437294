// SPDX-License-Identifier: MIT
#include "tests/coverage/Desk.h"

#include "boundary/environment/dtZelmars.h"
#include "platform/com/Component.h"
#include "platform/core/Clock.h"
#include "platform/core/UserName.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

struct Box {
    QString text;
    core::Icon icon;
    QString title;
    core::Answer answer;
};
QList<Box> queue;

core::Answer present(const QString& text, core::Icon icon, const QString& title,
                     core::Buttons buttons) {
    const bool choice = buttons == core::Buttons::YesNo;
    if (queue.isEmpty()) {
        ADD_FAILURE() << "nobody expected the box: " << text.toStdString();
        return choice ? core::Answer::No : core::Answer::Ok;
    }
    const Box expected = queue.takeFirst();
    EXPECT_EQ(text, expected.text);
    EXPECT_EQ(title, expected.title) << text.toStdString();
    EXPECT_EQ(icon, expected.icon) << text.toStdString();
    EXPECT_EQ(choice, expected.answer != core::Answer::Ok) << text.toStdString();
    return expected.answer;
}

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
    queue.clear();
    core::setMsgBoxPresenter(present);
    FakeVorlane::calls().clear();
    com::registerRunning(u"Vorlane.General"_s, [] { return new FakeVorlane; });
    core::setToday(QDate(2026, 5, 15));
    core::setUserName("operador");
    auto& environment = environment::dtZelmars::instance();
    reopen(environment.MSAccess(), book.connectionString());
    reopen(environment.SqlServer(), book.shapingConnectionString());
}

Desk::~Desk() {
    for (const Box& box : queue) ADD_FAILURE() << "a box never came: " << box.text.toStdString();
    auto& environment = environment::dtZelmars::instance();
    environment.MSAccess()->Close();
    environment.SqlServer()->Close();
    com::registerRunning(u"Vorlane.General"_s, {});
    core::setUserName({});
    core::setToday({});
    core::err().clear();
}

void Desk::expectBox(const QString& text, core::Icon icon, const QString& title,
                     core::Answer answer) {
    queue << Box{text, icon, title, answer};
}

coverage::Entry Desk::enter(const Document& document) const {
    const ado::RecordsetPtr row = ado::Recordset::create();
    row->Open(u"select * from tbzelmar_movimentos where movimento_id = 0"_s,
              environment::dtZelmars::instance().MSAccess(), ado::adOpenStatic,
              ado::adLockPessimistic, ado::adCmdUnknown);
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
            .Socio_ID = socio,
            .bHospital = document.hospital,
            .caption = caption,
            .Text3 = document.codABC,
            .Text6 = core::toText(document.doc_valor),
            .Text9 = core::toText(ninth),
            .DataCombo1 = u"01  -  Consultas"_s,
            .rubrica_id = document.rubrica_id};
}

coverage::PostingEntry Desk::posting(const coverage::Entry& entry) {
    return {.entry = entry,
            .DataCombo3 = u"TRF - Transferência"_s,
            .modo_pagamento = u"TRF"_s,
            .Text7 = u"15-05-2026"_s,
            .Text1 = u"12-05-2026"_s,
            .Text5 = u"FT 1/77"_s,
            .DataCombo2 = entry.bHospital ? u"H01 - Hospital da Luz Nova"_s : QString(),
            .askCheque = [](const ado::RecordsetPtr&) { ADD_FAILURE() << "no cheque wanted"; }};
}

bool Desk::post(const coverage::PostingEntry& posting) {
    queue.prepend(
        {u"Deseja finalizar o registo?"_s, core::Icon::Question, caption, core::Answer::Yes});
    return coverage::post(posting, run);
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

std::string Desk::kept(const coverage::Entry& entry, const char* column) {
    const QVariant value = entry.record->Collect(QString::fromLatin1(column));
    return core::isNull(value) ? "null" : core::toText(value).toStdString();
}

int failureOf(const std::function<void()>& statement) {
    try {
        statement();
    } catch (const core::Failure& failure) {
        EXPECT_FALSE(failure.text().isEmpty());
        return failure.number();
    }
    return 0;
}
