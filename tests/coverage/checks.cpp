// SPDX-License-Identifier: MIT
// What a try-out refuses before it calculates, what it shows, and what breaks it off.
#include "platform/core/Values.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

class TryOutChecks : public Desk {};

TEST_F(TryOutChecks, TheFirstOfSeveralFaultsIsToldAndNothingIsWritten) {
    coverage::Entry entry = enter(
        {.rubrica_id = book.childRubric({}), .doc_valor = -1, .hospital = true, .incidencia = 4});
    const auto put = [&](const QString& column, const QVariant& value) {
        entry.record->setCollect(column, value);
    };
    put(u"recebido"_s, 5);
    entry.bErroEntrada = true;
    for (QString* text : {&entry.DataCombo1, &entry.Text3, &entry.Text6, &entry.Text9})
        text->clear();
    const QString none = core::DefaultTitle.toString();
    struct Fault {
        QString text;
        Icon icon;
        QString title;
        std::function<void()> mend;
    };
    const Fault faults[] = {
        {u"O valor recebido é maior que o valor do documento."_s, Icon::None, none,
         [&] { put(u"recebido"_s, -0.01), put(u"incidencia"_s, {}); }},
        {u"O valor recebido é inferior a 0."_s, Icon::None, none, [&] { put(u"recebido"_s, {}); }},
        {u"O valor do documento é inferior a 0."_s, Icon::None, none,
         [&] { put(u"doc_valor"_s, 0); }},
        {u"Surgiu um erro grave durante a introdução dos dados no formulário, é aconcelhável que "
         "recomece outro registo."_s,
         Icon::Critical, caption, [&] { entry.bErroEntrada = false; }},
        {u"Tem de Indicar uma rubrica!"_s, Icon::Information, caption,
         [&] { entry.DataCombo1 = u"01"_s; }},
        {u"Não foi atribuido nenhum código de familiar!"_s, Icon::Information, caption,
         [&] { entry.Text3 = u"A"_s; }},
        {u"Tem de indicar o valor de incidência!"_s, Icon::Information, caption,
         [&] { put(u"incidencia"_s, 100); }},
        {u"Tem de indicar um valor para o documento!"_s, Icon::Information, caption,
         [&] { entry.Text6 = u"0"_s; }},
        {u"Tem de indicar um valor para o campo Recebido!"_s, Icon::Information, caption,
         [&] { entry.Text9 = u"100"_s; }}};
    for (const auto& fault : faults) {
        SCOPED_TRACE(fault.text.toStdString());
        run.bEnsaioValido = true;
        expectBox(fault.text, fault.icon, fault.title);
        tryOut(entry);
        EXPECT_FALSE(run.bEnsaioValido);
        fault.mend();
    }
    EXPECT_EQ(FakeVorlane::steps(), 0);
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
    EXPECT_FALSE(run.shown.LimiteAplicavel);
    tryOut(entry);
    EXPECT_TRUE(run.bEnsaioValido);
}

TEST_F(TryOutChecks, AFullRunShowsItsTwentyTwoStepsAndEveryResult) {
    tryOut(enter({.rubrica_id = book.childRubric({.socio = 500})}));
    EXPECT_TRUE(run.bEnsaioValido);
    QStringList calls = FakeVorlane::calls();
    EXPECT_EQ(calls.removeAll(u"setvalor(1)"_s), 22);
    EXPECT_EQ(calls, QStringList({u"made"_s,
                                  u"Iniciar(22, Evolução dos calculos, aguarde alguns momentos "
                                  ". . ., Processamento)"_s,
                                  u"terminar()"_s, u"gone"_s}));
    const coverage::Results& shown = run.shown;
    QStringList texts;
    for (const auto& result :
         {shown.LimiteAplicavel, shown.Incidencia, shown.Comparticipacao, shown.SaldoPlafond,
          shown.SaldoCC, shown.Iliquido, shown.Liquido, shown.Credito, shown.Debito})
        texts << (result ? core::toText(*result) : u"nothing"_s);
    EXPECT_EQ(texts.join(u' '), u"500 100 80 500 0 80 80 80 80"_s);
}

// The incidence of a document is filled by the run itself, so the first run cannot compare with it.
TEST_F(TryOutChecks, MoreReceivedThanTheDocumentIsWorthIsRefusedFromTheSecondRunOn) {
    const qint64 rubric = book.childRubric({});
    const coverage::Entry asMuch = enter({.rubrica_id = rubric, .recebido = 100});
    const coverage::Entry more = enter({.rubrica_id = rubric, .recebido = 120});
    for (const bool second : {false, true}) {
        tryOut(asMuch);
        EXPECT_TRUE(run.bEnsaioValido);
        EXPECT_EQ(kept(asMuch, "credito"), "0");
        if (second) expectBox(u"O valor recebido é maior que o valor do documento."_s);
        tryOut(more);
        EXPECT_EQ(run.bEnsaioValido, !second);
        EXPECT_EQ(kept(more, "credito"), "-20");
    }
}

TEST_F(TryOutChecks, WithoutAPercentageNothingCanBePostedButOneOfZeroPaysNothing) {
    const qint64 rubric = book.childRubric({.percent = 0});
    const coverage::Entry entry = enter({.rubrica_id = rubric});
    tryOut(entry);
    EXPECT_TRUE(run.bEnsaioValido);
    EXPECT_EQ(kept(entry, "credito"), "0");
    setRubric(rubric, "percent", {});
    FakeVorlane::calls().clear();
    expectBox(
        u"Erro: não foi possível calcular a comparticipação, porque não existe valor para a "
        "percentagem."_s);
    EXPECT_FALSE(post(entry));
    EXPECT_FALSE(run.bEnsaioValido);
    EXPECT_EQ(FakeVorlane::steps(), 2);
    EXPECT_EQ(FakeVorlane::calls().last(), u"gone"_s);
    EXPECT_EQ(stored("select zelmars from tbContadores"), "1");
}

TEST_F(TryOutChecks, AFailureGoesUpToTheCallerAndLeavesTheBookAsItWas) {
    const std::pair<const char*, QString> causes[] = {
        {"update tbZelmar_Plafonds set rubrica_id_main = null", u"A"_s},
        {"update tbZelmar_Plafonds set percent = 0.8", u"B'"_s},
        {"delete from tbZelmar_Plafonds", u"A"_s},
    };
    for (const auto& [change, code] : causes) {
        SCOPED_TRACE(change);
        const coverage::Entry entry = enter({.rubrica_id = book.childRubric({}), .codABC = code});
        book.exec(QString::fromLatin1(change));
        EXPECT_NE(failureOf([&] { tryOut(entry); }), 0);
        EXPECT_EQ(kept(entry, "credito"), "null");
        EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
    }
}

}  // namespace
