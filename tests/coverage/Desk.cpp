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
    core::Buttons buttons;
    core::Answer answer;
};

QList<Box>& queue() {
    static QList<Box> boxes;
    return boxes;
}

core::Answer present(const QString& text, core::Icon icon, const QString& title,
                     core::Buttons buttons) {
    if (queue().isEmpty()) {
        ADD_FAILURE() << "nobody expected the box: " << text.toStdString();
        return buttons == core::Buttons::Ok ? core::Answer::Ok : core::Answer::No;
    }
    const Box expected = queue().takeFirst();
    EXPECT_EQ(text.toStdString(), expected.text.toStdString());
    EXPECT_EQ(title.toStdString(), expected.title.toStdString()) << text.toStdString();
    EXPECT_EQ(icon, expected.icon) << text.toStdString();
    EXPECT_EQ(buttons, expected.buttons) << text.toStdString();
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

Boxes::Boxes() {
    queue().clear();
    core::setMsgBoxPresenter(present);
}

Boxes::~Boxes() {
    for (const Box& box : queue()) ADD_FAILURE() << "a box never came: " << box.text.toStdString();
    queue().clear();
}

void Boxes::expect(const QString& text, core::Icon icon, const QString& title) {
    queue() << Box{text, icon, title, core::Buttons::Ok, core::Answer::Ok};
}

void Boxes::ask(const QString& text, core::Icon icon, const QString& title, core::Answer answer) {
    queue() << Box{text, icon, title, core::Buttons::YesNo, answer};
}

QStringList& FakeVorlane::calls() {
    static QStringList calls;
    return calls;
}

void FakeVorlane::Iniciar(qint16 steps, const QString& text, const QString& title) {
    calls() << u"Iniciar(%1, %2, %3)"_s.arg(QString::number(steps), text, title);
}

void FakeVorlane::setvalor(qint16 steps) {
    calls() << u"setvalor(%1)"_s.arg(steps);
}

const QString Desk::caption = u"Lançamento (Plano de Saúde)"_s;

Desk::Desk() : socio(static_cast<qint32>(book.member({}))) {
    FakeVorlane::calls().clear();
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
    core::err().clear();
}

coverage::Entry Desk::enter(const Document& document) const {
    const ado::RecordsetPtr row = ado::Recordset::create();
    row->Open(u"select * from tbzelmar_movimentos where movimento_id = 0"_s,
              environment::dtZelmars::instance().MSAccess(), ado::adOpenStatic,
              ado::adLockPessimistic, ado::adCmdUnknown);
    row->AddNew();
    row->setCollect(u"data"_s, core::fromDate(core::today()));
    row->setCollect(u"tipo"_s, document.hospital ? u"HOS"_s : u"DOC"_s);
    row->setCollect(u"modo_pagamento"_s, u"TRF"_s);
    row->setCollect(u"codABC"_s, document.codABC);
    row->setCollect(u"rubrica_id"_s, document.rubrica_id);
    row->setCollect(u"doc_data"_s, core::fromDate(core::today().addDays(-3)));
    row->setCollect(u"doc_no"_s, u"FT 1/77"_s);
    row->setCollect(u"doc_valor"_s, document.doc_valor);
    const QVariant& ninth = document.hospital ? document.incidencia : document.recebido;
    row->setCollect(document.hospital ? u"incidencia"_s : u"recebido"_s, ninth);

    coverage::Entry entry;
    entry.record = row;
    entry.Socio_ID = socio;
    entry.bHospital = document.hospital;
    entry.caption = caption;
    entry.Text3 = document.codABC;
    entry.Text6 = core::toText(document.doc_valor);
    entry.Text9 = core::toText(ninth);
    entry.DataCombo1 = u"01  -  Consultas"_s;
    entry.rubrica_id = document.rubrica_id;
    return entry;
}

coverage::PostingEntry Desk::posting(const coverage::Entry& entry) const {
    coverage::PostingEntry posting;
    posting.entry = entry;
    posting.DataCombo3 = u"TRF - Transferência"_s;
    posting.modo_pagamento = u"TRF"_s;
    posting.Text7 = u"15-05-2026"_s;
    posting.Text1 = u"12-05-2026"_s;
    posting.Text5 = u"FT 1/77"_s;
    posting.DataCombo2 = entry.bHospital ? u"H01 - Hospital da Luz Nova"_s : QString();
    posting.askCheque = [](const ado::RecordsetPtr&) { ADD_FAILURE() << "no cheque was wanted"; };
    return posting;
}

bool Desk::post(const coverage::PostingEntry& posting) {
    queue().prepend({u"Deseja finalizar o registo?"_s, core::Icon::Question, caption,
                     core::Buttons::YesNo, core::Answer::Yes});
    return coverage::post(posting, run);
}

void Desk::accumulated(const QString& codABC, qint64 rubrica_id, double credit, int documents) {
    book.insert(
        u"tbSocios_Acumulados"_s,
        {{"socio_id", socio},
         {"codABC", codABC},
         {"rubrica_id", rubrica_id},
         {"rubrica_id_main",
          book.value(u"select rubrica_id_main from tbZelmar_Plafonds where rubrica_id = %1"_s.arg(
              rubrica_id))},
         {"debito_ac", credit},
         {"credito_ac", credit},
         {"no_docs", documents}});
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
