// SPDX-License-Identifier: MIT
// Whom and what a try-out and a posting refuse.
#include <functional>

#include "entry/Beneficiary.h"
#include "platform/core/Clock.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

class Checks : public Desk {};

TEST_F(Checks, TheFirstOfSeveralFaultsIsToldAndNothingIsPosted) {
    coverage::Posting bill = posting(enter(
        {.rubrica_id = book.childRubric({}), .doc_valor = -1, .hospital = true, .incidencia = 4}));
    coverage::Document& entry = bill.document;
    const auto put = [&](const QString& column, const QVariant& value) {
        entry.record->setCollect(column, value);
    };
    put(u"recebido"_s, 5);
    for (QString* text : {&entry.rubric, &entry.personCode, &entry.documentValue,
                          &entry.receivedOrIncidence, &bill.paymentMode, &bill.movementDate,
                          &bill.documentDate, &bill.documentNumber, &bill.hospital})
        text->clear();
    book.exec(u"update tbSocios set nib = null"_s);
    const QString none = core::DefaultTitle.toString();
    struct Fault {
        QString text;
        std::function<void()> mend;
        Icon icon = Icon::Information;
        QString title = caption;
    };
    const Fault faults[] = {
        {u"O valor recebido é maior que o valor do documento."_s,
         [&] { put(u"recebido"_s, -0.01), put(u"incidencia"_s, {}); }, Icon::None, none},
        {u"O valor recebido é inferior a 0."_s, [&] { put(u"recebido"_s, {}); }, Icon::None, none},
        {u"O valor do documento é inferior a 0."_s, [&] { put(u"doc_valor"_s, 0); }, Icon::None,
         none},
        {u"Tem de Indicar uma rubrica!"_s, [&] { entry.rubric = u"01"_s; }},
        {u"Não foi atribuido nenhum código de familiar!"_s, [&] { entry.personCode = u"A"_s; }},
        {u"Tem de indicar o valor de incidência!"_s, [&] { put(u"incidencia"_s, 100); }},
        {u"Tem de indicar um valor para o documento!"_s, [&] { entry.documentValue = u"0"_s; }},
        {u"Tem de indicar um valor para o campo Recebido!"_s,
         [&] { entry.receivedOrIncidence = u"100"_s; }},
        {u"Tem de indicar um modo de pagamento."_s, [&] { bill.paymentMode = u"TRF"_s; }},
        {u"Tem de introduzir a data do registo."_s, [&] { bill.movementDate = u"15-05-2026"_s; }},
        {u"Tem de introduzir a data do documento."_s, [&] { bill.documentDate = u"12-05-2026"_s; }},
        {u"Tem de introduzir o número do documento."_s, [&] { bill.documentNumber = u"1"_s; }},
        {u"Tem de indicar um hospital."_s, [&] { bill.hospital = u"H01"_s; }},
        {u"Este Associado não tem NIB!"_s,
         [&] { book.exec(u"update tbSocios set nib = 'não é um número 1234'"_s); }, Icon::Critical,
         none},
        {u"Este Associado tem especificado um NIB INVÁLIDO!"_s,
         [&] { book.exec(u"update tbSocios set nib = 'não é um número 12345'"_s); }, Icon::Critical,
         none},
    };
    for (const auto& fault : faults) {
        EXPECT_FALSE(post(bill, {{.text = fault.text, .icon = fault.icon, .title = fault.title}}));
        fault.mend();
    }
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
    EXPECT_EQ(stored("select zelmars from tbContadores"), "1");
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s, u"credito_ac <> 0 or no_docs <> 0"_s), 0);
    // A member who has left is told, but gets what is his.
    book.exec(u"delete from tbSocios"_s);
    EXPECT_TRUE(post(bill, {{.text = u"Este Associado não se encontra na tabela de Activos."_s,
                             .icon = Icon::Critical,
                             .title = none}}));
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 1);
}

// The incidence of a document is filled by the run itself, so the first run cannot compare with it.
TEST_F(Checks, MoreReceivedThanTheDocumentIsWorthIsRefusedFromTheSecondRunOn) {
    const coverage::Document more = enter({.rubrica_id = book.childRubric({}), .recebido = 120});
    tryOut(more);
    EXPECT_TRUE(run.bEnsaioValido);
    EXPECT_EQ(kept(more, "credito"), "-20");
    EXPECT_EQ(kept(more, "debito"), "0");
    expectBox(u"O valor recebido é maior que o valor do documento."_s);
    tryOut(more);
    EXPECT_FALSE(run.bEnsaioValido);
}

// Today is 15 May 2026.
TEST_F(Checks, PersonsAreAdmittedByAgeAndWaitingPeriod) {
    const QDate today = core::today();
    const QDate yesterday = today.addDays(-1);
    const QString tooOld = u"Este familiar tem mais de 25 anos! Tente indicar outro."_s;
    const QString relativeWaits =
        u"Este familiar está dentro do periodo de carência! Não pode ser processado o documento."_s;
    const QString memberWaits =
        u"O Associado está dentro do periodo de carência! Não pode ser processado o documento."_s;
    const QVariant none;
    const struct {
        const char* code;
        QVariant birth, waiting, memberWaiting;
        QString refusal;
    } rows[] = {
        {"C1", today.addDays(-9131), none, none, {}},
        {"C1", today.addDays(-9132), none, none, tooOld},
        // The child's letter counts first, wherever it stands.
        {"cA", today.addDays(-9132), none, none, tooOld},
        {"C1", none, none, none, tooOld},
        {"C1", today.addDays(-9131), today, none, relativeWaits},
        {"B", none, today, none, relativeWaits},
        {"B", none, yesterday, today, {}},
        {"A", none, none, today, memberWaits},
        {"A", none, today, yesterday, {}},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(std::string(row.code) + " " + row.refusal.toStdString());
        const qint64 id = book.person({.socio_id = socio,
                                       .codABC = QString::fromLatin1(row.code),
                                       .data_nascimento = row.birth,
                                       .data_carencia = row.waiting});
        const qint64 member = book.member({.zelmar_data_carencia = row.memberWaiting});
        if (!row.refusal.isEmpty())
            expectBox(row.refusal, Icon::Information,
                      row.refusal == tooOld ? u"Familiares"_s : u"Periodo de Carência"_s);
        EXPECT_EQ(entry::admitPerson(id, static_cast<qint32>(member)).has_value(),
                  row.refusal.isEmpty());
    }
}

}  // namespace
