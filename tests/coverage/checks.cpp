// SPDX-License-Identifier: MIT
// What a try-out refuses before it calculates, the minimum of a document, and the plan's share.
#include "boundary/environment/dtZelmars.h"
#include "platform/com/Component.h"
#include "platform/core/Values.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

class TryOutChecks : public Desk {};

/// One thing that is wrong, and what mends it.
struct Fault {
    QString text;
    Icon icon;
    QString title;
    std::function<void(coverage::Entry&)> mend;
};

auto put(const char* column, const QVariant& value) {
    return [=](coverage::Entry& entry) {
        entry.record->setCollect(QString::fromLatin1(column), value);
    };
}

TEST_F(TryOutChecks, TheFirstOfSeveralFaultsIsToldAndNothingIsWritten) {
    const qint64 rubric = book.childRubric({});
    const QString none = core::DefaultTitle.toString();
    coverage::Entry entry =
        enter({.rubrica_id = rubric, .doc_valor = -1, .hospital = true, .incidencia = 4});
    entry.record->setCollect(u"recebido"_s, 5);
    entry.bErroEntrada = true;
    entry.DataCombo1.clear();
    entry.Text3.clear();
    entry.Text6.clear();
    entry.Text9.clear();
    const std::vector<Fault> faults{
        {u"O valor recebido é maior que o valor do documento."_s, Icon::None, none,
         [](coverage::Entry& at) {
             put("recebido", -0.01)(at);
             put("incidencia", {})(at);
         }},
        {u"O valor recebido é inferior a 0."_s, Icon::None, none, put("recebido", {})},
        {u"O valor do documento é inferior a 0."_s, Icon::None, none, put("doc_valor", 0)},
        {u"Surgiu um erro grave durante a introdução dos dados no formulário, é aconcelhável que "
         "recomece outro registo."_s,
         Icon::Critical, caption, [](coverage::Entry& at) { at.bErroEntrada = false; }},
        {u"Tem de Indicar uma rubrica!"_s, Icon::Information, caption,
         [](coverage::Entry& at) { at.DataCombo1 = u"01"_s; }},
        {u"Não foi atribuido nenhum código de familiar!"_s, Icon::Information, caption,
         [](coverage::Entry& at) { at.Text3 = u"A"_s; }},
        {u"Tem de indicar o valor de incidência!"_s, Icon::Information, caption,
         put("incidencia", 100)},
        {u"Tem de indicar um valor para o documento!"_s, Icon::Information, caption,
         [](coverage::Entry& at) { at.Text6 = u"0"_s; }},
        {u"Tem de indicar um valor para o campo Recebido!"_s, Icon::Information, caption,
         [](coverage::Entry& at) { at.Text9 = u"100"_s; }}};
    for (const Fault& fault : faults) {
        SCOPED_TRACE(fault.text.toStdString());
        FakeVorlane::calls().clear();
        run.bEnsaioValido = true;
        boxes.expect(fault.text, fault.icon, fault.title);
        tryOut(entry);
        EXPECT_FALSE(run.bEnsaioValido);
        EXPECT_EQ(FakeVorlane::calls(), QStringList({u"made"_s, u"gone"_s}));
        fault.mend(entry);
    }
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
    EXPECT_FALSE(run.shown.LimiteAplicavel);
    tryOut(entry);
    EXPECT_TRUE(run.bEnsaioValido);
}

TEST_F(TryOutChecks, AFullRunShowsItsTwentyTwoStepsAndEveryResult) {
    const coverage::Entry entry = enter({.rubrica_id = book.childRubric({.socio = 500})});
    tryOut(entry);
    EXPECT_TRUE(run.bEnsaioValido);
    QStringList calls = FakeVorlane::calls();
    EXPECT_EQ(calls.removeAll(u"setvalor(1)"_s), 22);
    EXPECT_EQ(calls, QStringList({u"made"_s,
                                  u"Iniciar(22, Evolução dos calculos, aguarde alguns momentos "
                                  ". . ., Processamento)"_s,
                                  u"terminar()"_s, u"gone"_s}));
    const auto shown = [](const std::optional<QVariant>& value) {
        return value ? core::toText(*value).toStdString() : "nothing";
    };
    EXPECT_EQ(shown(run.shown.LimiteAplicavel), "500");
    EXPECT_EQ(shown(run.shown.Incidencia), "100");
    EXPECT_EQ(shown(run.shown.Comparticipacao), "80");
    EXPECT_EQ(shown(run.shown.SaldoPlafond), "500");
    EXPECT_EQ(shown(run.shown.SaldoCC), "0");
    EXPECT_EQ(shown(run.shown.Iliquido), "80");
    EXPECT_EQ(shown(run.shown.Liquido), "80");
    EXPECT_EQ(shown(run.shown.Credito), "80");
    EXPECT_EQ(shown(run.shown.Debito), "80");
}

// The incidence of a document is filled by the run itself, so the first run cannot compare with it.
TEST_F(TryOutChecks, MoreReceivedThanTheDocumentIsWorthIsRefusedFromTheSecondRunOn) {
    const coverage::Entry entry = enter({.rubrica_id = book.childRubric({}), .recebido = 120});
    tryOut(entry);
    EXPECT_TRUE(run.bEnsaioValido);
    EXPECT_EQ(kept(entry, "iliquido"), "-20");
    EXPECT_EQ(kept(entry, "liquido"), "-20");
    EXPECT_EQ(kept(entry, "credito"), "-20");
    EXPECT_EQ(kept(entry, "debito"), "0");
    boxes.expect(u"O valor recebido é maior que o valor do documento."_s);
    tryOut(entry);
    EXPECT_FALSE(run.bEnsaioValido);
}

TEST_F(TryOutChecks, AsMuchReceivedAsTheDocumentIsWorthPassesEveryRun) {
    const coverage::Entry entry = enter({.rubrica_id = book.childRubric({}), .recebido = 100});
    for (int i = 0; i < 2; ++i) {
        tryOut(entry);
        EXPECT_TRUE(run.bEnsaioValido);
        EXPECT_EQ(kept(entry, "credito"), "0");
    }
}

TEST_F(TryOutChecks, WithoutAPercentageNothingCanBePosted) {
    const qint64 rubric = book.childRubric({});
    setRubric(rubric, "percent", {});
    const coverage::Entry entry = enter({.rubrica_id = rubric});
    boxes.expect(
        u"Erro: não foi possível calcular a comparticipação, porque não existe valor para a "
        "percentagem."_s);
    EXPECT_FALSE(post(entry));
    EXPECT_FALSE(run.bEnsaioValido);
    EXPECT_EQ(kept(entry, "incidencia"), "100");
    EXPECT_EQ(FakeVorlane::steps(), 2);
    EXPECT_EQ(FakeVorlane::calls().count(u"terminar()"_s), 1);
    EXPECT_EQ(FakeVorlane::calls().last(), u"gone"_s);
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
    EXPECT_EQ(stored("select zelmars from tbContadores"), "1");
}

TEST_F(TryOutChecks, APercentageOfZeroPaysNothing) {
    const coverage::Entry entry = enter({.rubrica_id = book.childRubric({.percent = 0})});
    tryOut(entry);
    EXPECT_TRUE(run.bEnsaioValido);
    EXPECT_EQ(kept(entry, "comparticipacao"), "0");
    EXPECT_EQ(kept(entry, "credito"), "0");
}

/// A document that cannot be calculated. The flag stays as the checks left it.
struct Breakdown {
    const char* name;
    std::function<void(support::Book&, coverage::Entry&)> cause;
    int failure;  ///< its number; 0 where any will do
    bool valid;
};

class Breakdowns : public Desk, public ::testing::WithParamInterface<Breakdown> {};

TEST_P(Breakdowns, GoUpToTheCallerAndLeaveTheBookAsItWas) {
    const qint64 rubric = book.childRubric({});
    coverage::Entry entry = enter({.rubrica_id = rubric});
    GetParam().cause(book, entry);
    const int failure = failureOf([&] { tryOut(entry); });
    EXPECT_EQ(failure, GetParam().failure ? GetParam().failure : failure);
    EXPECT_NE(failure, 0);
    EXPECT_EQ(run.bEnsaioValido, GetParam().valid);
    EXPECT_EQ(kept(entry, "credito"), "null");
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 0);
}

INSTANTIATE_TEST_SUITE_P(
    TryOut, Breakdowns,
    ::testing::Values(
        Breakdown{"OfARubricThatIsGone",
                  [](support::Book& book, coverage::Entry&) {
                      book.exec(u"delete from tbZelmar_Plafonds"_s);
                  },
                  core::NoCurrentRow, true},
        Breakdown{"OfATextThatIsNoRubric",
                  [](support::Book&, coverage::Entry& entry) { entry.rubrica_id = {}; }, 0, true},
        Breakdown{"OfARubricOutsideEveryGroup",
                  [](support::Book& book, coverage::Entry&) {
                      book.exec(u"update tbZelmar_Plafonds set rubrica_id_main = null"_s);
                  },
                  0, true},
        Breakdown{"OfAQuoteInThePersonsCode",
                  [](support::Book&, coverage::Entry& entry) { entry.Text3 = u"B'"_s; }, 0, true},
        Breakdown{"OfAShareThatOverflows",
                  [](support::Book& book, coverage::Entry&) {
                      book.exec(u"update tbZelmar_Plafonds set percent = 1e39"_s);
                  },
                  core::Overflow, true},
        Breakdown{"OfAMissingProgressWindow",
                  [](support::Book&, coverage::Entry&) {
                      com::registerRunning(u"Vorlane.General"_s, {});
                  },
                  core::CannotCreateObject, false}),
    [](const auto& at) { return std::string(at.param.name); });

}  // namespace
