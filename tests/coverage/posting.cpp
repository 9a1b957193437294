// SPDX-License-Identifier: MIT
// What a posting writes, and what the book holds when a write fails.
#include "platform/core/Values.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

class Posting : public Desk {
protected:
    void refuse(const QString& write) { book.refuse(write, u"disco cheio"_s); }
    /// The next number, the movements' numbers, and the sums of the accumulators.
    void expectState(const char* expected) {
        EXPECT_EQ(stored("select (select zelmars from tbContadores), "
                         "(select max(movimento_no) from tbZelmar_Movimentos), "
                         "round(cast(sum(credito_ac) as numeric), 2), "
                         "round(cast(sum(debito_ac) as numeric), 2), sum(no_docs) "
                         "from tbSocios_Acumulados"),
                  expected);
    }

    const qint64 rubric = book.childRubric({});
};

TEST_F(Posting, WritesTheMovementItsNumberAndTheTotals) {
    EXPECT_TRUE(post(enter({.rubrica_id = rubric, .codABC = u"B"_s, .doc_valor = 87.35})));
    EXPECT_TRUE(post(enter({.rubrica_id = rubric,
                            .codABC = u"B"_s,
                            .doc_valor = 250,
                            .hospital = true,
                            .incidencia = 200})));
    EXPECT_EQ(stored("select movimento_no, socio_id = (select socio_id from tbSocios), codABC, "
                     "tipo, doc_valor, incidencia, comparticipacao, iliquido, liquido, credito, "
                     "debito, created_by, data "
                     "from tbZelmar_Movimentos order by movimento_id"),
              "1|1|B|DOC|87.35|87.35|69.88|69.88|69.88|69.88|69.88|operador|2026-05-15 00:00:00\n"
              "2|1|B|HOS|250|200|160|160|160|160|250|operador|2026-05-15 00:00:00");
    expectState("3|2|229.88|319.88|2");
}

TEST_F(Posting, AsksAboutUnusualValuesBeforeItTriesOutAndNotAgain) {
    const coverage::Posting entry =
        posting(enter({.rubrica_id = rubric, .doc_valor = 1'000'000.5}));
    entry.document.record->setCollect(u"doc_data"_s, core::fromDate({1926, 5, 12}));
    const auto asks = [&](const QString& text, core::Answer answer) {
        person.expectBox({.text = text, .answer = answer, .icon = Icon::Question});
    };
    const QString finish = u"Deseja finalizar o registo?"_s;
    const QString day = u"A data do documento é 12-05-1926. Está certa?"_s;
    const QString value = u"O valor do documento é € 1.000.000,50. Está certo?"_s;
    asks(finish, core::Answer::Yes);
    asks(day, core::Answer::Yes);
    asks(value, core::Answer::No);
    EXPECT_FALSE(coverage::post(entry, run, begun));
    EXPECT_EQ(book.count(u"tbSocios_Acumulados"_s), 0);
    asks(finish, core::Answer::Yes);
    asks(value, core::Answer::Yes);
    EXPECT_TRUE(coverage::post(entry, run, begun));
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 1);
}

TEST_F(Posting, OnAnEmptyCounterGivesTheNumberOneTwice) {
    book.exec(u"delete from tbContadores"_s);
    for (int i = 0; i < 3; ++i) EXPECT_TRUE(post(enter({.rubrica_id = rubric})));
    EXPECT_EQ(stored("select movimento_no from tbZelmar_Movimentos union all "
                     "select zelmars from tbContadores"),
              "1\n1\n2\n3");
}

// Counter, movement and accumulator are three writes.
TEST_F(Posting, ThatFailsToWriteTheCounterSavesNothing) {
    const coverage::Posting entry = posting(enter({.rubrica_id = rubric}));
    tryOut(entry.document);
    const auto failToPost = [&](const QString& description) {
        EXPECT_FALSE(
            post(entry,
                 {{.text = description, .icon = Icon::None, .title = u"Zelmars"_s, .partly = true},
                  {.text = u"Não foi possível registar o registo, contacte o "
                           "Administrador do Sistema."_s,
                   .icon = Icon::Critical,
                   .title = caption}}));
        expectState("1|NULL|0|0|0");
        EXPECT_FALSE(begun.isRegistered);
    };
    book.hold(u"tbContadores"_s);
    failToPost(support::onServer() ? u"canceling statement due to lock timeout"_s
                                   : u"database is locked"_s);
    book.letGo();
    refuse(u"update on tbContadores"_s);
    failToPost(u"disco cheio"_s);
    book.refuseNoMore();
    EXPECT_TRUE(post(entry));
    expectState("2|1|80|80|1");
}

const char* const Journal =
    "select operacao, passo, ficheiro, movimento_no, tipo, concluida is null, "
    "movimento_id = (select max(movimento_id) from tbZelmar_Movimentos), "
    "quem like '%@%' and quando is not null from tbOperacoes";

TEST_F(Posting, ThatLacksTheAccumulatorIsFinishedByTheNextPressWhichAsksAndStoresNothingTwice) {
    const coverage::Posting entry = posting(enter({.rubrica_id = rubric}));
    tryOut(entry.document);
    refuse(u"update on tbSocios_Acumulados"_s);
    const support::Operator::Box missing{
        .text =
            u"O movimento nº 1 está registado, mas falta somar aos acumulados.\n\ndisco cheio"_s,
        .icon = Icon::Critical,
        .title = caption,
        .partly = true};
    EXPECT_FALSE(post(entry, {missing}));
    EXPECT_EQ(stored(Journal), "LAN|ACU|ACTIVO|1|DOC|1|1|1");
    // Neither what is typed since nor another press without success changes anything.
    entry.document.record->setCollect(u"credito"_s, 1);
    person.expectBox(missing);
    EXPECT_FALSE(coverage::post(entry, run, begun));
    expectState("2|1|0|0|0");
    book.refuseNoMore();
    EXPECT_TRUE(coverage::post(entry, run, begun));
    expectState("2|1|80|80|1");
    EXPECT_EQ(stored(Journal), "");
    EXPECT_TRUE(coverage::post(entry, run, begun)) << "there is nothing left";
    expectState("2|1|80|80|1");
}

// The row is written, but the program does not learn it.
TEST_F(Posting, WhoseAnswerWasLostIsFoundAgainByTheNextPress) {
    const coverage::Posting entry = posting(enter({.rubrica_id = rubric}));
    refuse(u"update on tbSocios_Acumulados"_s);
    EXPECT_FALSE(post(entry, {{.text = u"falta somar"_s, .partly = true}}));
    book.refuseNoMore();
    const coverage::Posting again = posting(enter({.rubrica_id = rubric}));
    data::Operation unaware;
    unaware.id = begun.id;
    EXPECT_TRUE(coverage::post(again, run, unaware));
    expectState("2|1|80|80|1");
}

TEST_F(Posting, FinishedBySomebodyElseMeanwhileIsNotAddedTwice) {
    const coverage::Posting entry = posting(enter({.rubrica_id = rubric}));
    refuse(u"update on tbSocios_Acumulados"_s);
    EXPECT_FALSE(post(entry, {{.text = u"falta somar"_s, .partly = true}}));
    book.refuseNoMore();
    for (const char* const elsewhere :
         {"update tbOperacoes set passo = null", "delete from tbOperacoes"}) {
        data::Operation mine = begun;
        book.exec(QString::fromUtf8(elsewhere));
        EXPECT_TRUE(coverage::post(entry, run, mine));
        EXPECT_EQ(mine.missing, data::Step::Nothing);
        expectState("2|1|0|0|0");
    }
}

TEST_F(Posting, InABookOfAnOlderProgramWorksWithoutAJournal) {
    book.exec(u"drop table tbOperacoes"_s);
    const coverage::Posting entry = posting(enter({.rubrica_id = rubric}));
    refuse(u"update on tbSocios_Acumulados"_s);
    EXPECT_FALSE(post(entry, {{.text = u"falta somar"_s, .partly = true}}));
    book.refuseNoMore();
    EXPECT_TRUE(coverage::post(entry, run, begun));
    EXPECT_TRUE(post(enter({.rubrica_id = rubric})));
    expectState("3|2|160|160|2");
}

}  // namespace
