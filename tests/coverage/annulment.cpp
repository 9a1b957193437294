// SPDX-License-Identifier: MIT
// What an annulment writes, and what the book holds when a write fails.
#include "coverage/annulment.h"

#include "boundary/environment/dtZelmars.h"
#include "coverage/Queries.h"
#include "platform/core/Failure.h"
#include "tests/coverage/Desk.h"
#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;
using core::Icon;

namespace {

/// The host's object, which is called back and fails.
class Caller : public QObject {
    Q_OBJECT
public:
    qint32 key = 0;
    Q_INVOKABLE void RemoteKey(const QVariant& movimento_id) {
        key = movimento_id.toInt();
        throw core::Failure(core::InvalidCall, u"não interessa"_s);
    }
};

class Annulment : public Desk {
protected:
    /// A movement with an accumulator that counts it, of an active member or of one who has left.
    qint64 movement(const QString& suffix, const QString& tipo, const QString& hospital_id) {
        book.exec(
            u"insert into tbSocios_Acumulados%1 (socio_id, codABC, rubrica_id, debito_ac, "
            "credito_ac, no_docs) values (%2, 'B', 7, 150, 90.5, 3)"_s.arg(suffix)
                .arg(socio));
        book.exec(
            u"insert into tbZelmar_Movimentos%1 (movimento_no, socio_id, codABC, rubrica_id, "
            "hospital_id, tipo, modo_pagamento, doc_no, doc_data, doc_valor, incidencia, "
            "liquido, credito, debito, created_by) values (31, %2, 'B', 7, %3, '%4', 'TRF', "
            "'FT 9', '2026-02-01 00:00:00', 100, 100, 50, 40.25, 100, 'ana')"_s.arg(
                suffix, QString::number(socio), hospital_id, tipo));
        return book.value(u"select movimento_id from tbZelmar_Movimentos"_s + suffix).toLongLong();
    }
    qint64 document() { return movement({}, u"DOC"_s, u"null"_s); }
    bool annul(qint64 key, core::Answer answer = core::Answer::Yes) {
        const core::HandlerScope handler;
        const auto row = ado::Recordset::create();
        row->Open(u"select * from vwZelmars_Movimentos_Vigor where movimento_id = %1"_s.arg(key),
                  environment::dtZelmars::instance().MSAccess(), ado::adOpenDynamic,
                  ado::adLockOptimistic, ado::adCmdUnknown);
        if (vanishes) book.exec(u"delete from tbZelmar_Movimentos"_s);
        person.expectBox({.text = u"Deseja anular este registo?"_s,
                          .answer = answer,
                          .icon = Icon::Question,
                          .title = u"Anular Lançamento"_s});
        if (vanishes) expectBox(u"Não foi possível anular este registo"_s, Icon::Critical, caption);
        if (!afterwards.text.isEmpty()) person.expectBox(afterwards);
        begun = {};
        const bool mayGo = coverage::annul({row, caption, &caller}, begun);
        shown = row;
        person.expectNoBoxesLeft();
        return mayGo;
    }
    /// A further press of the same button.
    bool again() {
        const core::HandlerScope handler;
        if (!afterwards.text.isEmpty()) person.expectBox(afterwards);
        const bool mayGo = coverage::annul({shown, caption, &caller}, begun);
        person.expectNoBoxesLeft();
        return mayGo;
    }
    std::string movements(const QString& suffix = {}) {
        return book
            .text(
                u"select movimento_no, tipo, modo_pagamento, data, codABC, rubrica_id, doc_no, "
                "doc_data, doc_valor, hospital_id, credito, debito, incidencia, liquido, "
                "created_by from tbZelmar_Movimentos%1 order by movimento_id"_s.arg(suffix))
            .toStdString();
    }
    std::string totals(const QString& suffix = {}) {
        return book
            .text(u"select debito_ac, credito_ac, no_docs from tbSocios_Acumulados"_s + suffix)
            .toStdString();
    }

    void failStepByStep();

    bool vanishes = false;              ///< the movement, after it was read
    support::Operator::Box afterwards;  ///< closes the annulment; without a text none
    Caller caller;
    ado::RecordsetPtr shown;  ///< by the last annulment
};

TEST_F(Annulment, MarksTheMovementCorrectsItTakesTheTotalsBackAndRaisesTheFranchiseUsed) {
    const qint64 key = document();
    const qint64 bill = movement(u"_Inactivos"_s, u"HOS"_s, u"5"_s);
    const QString franchise =
        u"select t_iliquido - t_credito from (%1) f"_s.arg(coverage::queries::franchise(socio, 7));
    EXPECT_FALSE(annul(key, core::Answer::No));
    EXPECT_EQ(totals(), "150|90.5|3");
    EXPECT_EQ(book.value(franchise).toDouble(), 9.75);
    const std::string before = movements(u"_Inactivos"_s);

    EXPECT_TRUE(annul(key));
    EXPECT_EQ(caller.key, key);
    EXPECT_EQ(book.value(franchise).toDouble(), 50) << "more is used, by the credit annulled";
    EXPECT_EQ(movements(),
              "31|ANL|ANL|NULL|B|7|FT 9|2026-02-01 00:00:00|100|NULL|40.25|100|100|50|ana\n"
              "1|COR|NULL|2026-05-15 00:00:00|B|7|FT 9|2026-02-01 00:00:00|100|NULL|-40.25|-100|"
              "NULL|NULL|NULL");
    EXPECT_EQ(totals(), "50|50.25|2");
    EXPECT_EQ(movements(u"_Inactivos"_s), before);
    EXPECT_EQ(totals(u"_Inactivos"_s), "150|90.5|3");

    EXPECT_TRUE(annul(bill));
    EXPECT_EQ(movements(u"_Inactivos"_s),
              "31|ANL|ANL|NULL|B|7|FT 9|2026-02-01 00:00:00|100|5|40.25|100|100|50|ana\n"
              "2|COR|NULL|2026-05-15 00:00:00|B|7|FT 9|2026-02-01 00:00:00|100|5|-40.25|-100|"
              "NULL|NULL|NULL");
    EXPECT_EQ(totals(u"_Inactivos"_s), "50|50.25|2");
    EXPECT_EQ(book.count(u"tbZelmar_Movimentos"_s), 2);
    EXPECT_EQ(totals(), "50|50.25|2");
}

TEST_F(Annulment, OfAMovementThatVanishedMeanwhileGoesOn) {
    const qint64 key = document();
    vanishes = true;
    EXPECT_TRUE(annul(key));
    EXPECT_EQ(stored("select tipo, credito from tbZelmar_Movimentos"), "COR|-40.25");
    EXPECT_EQ(totals(), "50|50.25|2");
    EXPECT_EQ(stored("select passo, movimento_no, correcao_no from tbOperacoes"), "NULL|31|1");
}

TEST_F(Annulment, OfAMovementThatSomebodyAnnulledMeanwhileSaysByWhomAndWritesNothing) {
    const qint64 key = document();
    EXPECT_TRUE(annul(key));
    const std::string before = movements() + totals();
    book.exec(u"update tbOperacoes set quem = 'ana@posto2', quando = '2026-05-14 10:15:00'"_s);
    afterwards = {.text =
                      u"O movimento nº 31 já foi anulado por ana@posto2, em 14-05-2026, 10:15. "
                      "Nada foi gravado."_s,
                  .icon = Icon::Information,
                  .title = caption};
    caller.key = 0;
    EXPECT_TRUE(annul(key)) << "the screen may go";
    EXPECT_EQ(caller.key, key) << "the list is to be read afresh";
    book.exec(u"update tbOperacoes set passo = 'COR'"_s);
    afterwards.text.replace(u"10:15"_s,
                            u"10:15 (falta o movimento de correção e tirar dos acumulados)"_s);
    EXPECT_TRUE(annul(key));
    EXPECT_EQ(movements() + totals(), before);
}

TEST_F(Annulment, LeavesTheTotalsAloneWhenAFailureWasPending) {
    const core::HandlerScope handler;
    core::err().set(core::RowInUse, u"em uso"_s);
    afterwards = {.text = u"Erro não especificado, contacte o Administrador do Sistema. em uso"_s,
                  .icon = Icon::Critical,
                  .title = caption};
    EXPECT_TRUE(annul(document()));
    EXPECT_EQ(stored("select count(*) from tbZelmar_Movimentos"), "2");
    EXPECT_EQ(totals(), "150|90.5|3");
}

TEST_F(Annulment, OfAMovementWithoutAmountsKeepsThemNull) {
    const qint64 rubric = book.childRubric({});
    setRubric(rubric, "nomax_recibos_socio", 1);
    accumulated(u"A"_s, rubric, 12);
    EXPECT_TRUE(post(posting(enter({.rubrica_id = rubric})),
                     {{.text = u"O limite máximo do nº de documentos"_s, .partly = true}}));
    book.exec(u"update tbZelmar_Movimentos set doc_valor = null"_s);
    EXPECT_TRUE(annul(book.value(u"select movimento_id from tbZelmar_Movimentos"_s).toLongLong()));
    EXPECT_EQ(stored("select tipo, doc_valor, credito, debito from tbZelmar_Movimentos order by 1"),
              "ANL|NULL|NULL|NULL\nCOR|NULL|NULL|NULL");
    EXPECT_EQ(totals(), "NULL|NULL|1");
}

// Mark, counter, correcting row and accumulator are four writes.
void Annulment::failStepByStep() {
    const qint64 key = document();
    const char* const state =
        "select zelmars, min(tipo), max(case tipo when 'COR' then movimento_no end) "
        "from tbContadores, tbZelmar_Movimentos group by 1";
    book.refuse(u"update on tbZelmar_Movimentos"_s, u"disco cheio"_s);
    EXPECT_TRUE(support::failureOf([&] { annul(key); }).text().contains(u"disco cheio"_s));
    EXPECT_EQ(stored(state), "1|DOC|NULL");
    book.refuseNoMore();
    const struct {
        const char* write;
        QString box;
        const char* rows;
    } failures[] = {
        {"update on tbContadores",
         u"O movimento nº 31 está marcado como anulado, mas falta o movimento de correção e tirar "
         "dos acumulados.\n\ndisco cheio"_s,
         "1|ANL|NULL"},
        {"insert on tbZelmar_Movimentos", u"O movimento nº 31 está marcado como anulado"_s,
         "2|ANL|NULL"},
        {"update on tbSocios_Acumulados",
         u"O movimento nº 31 está anulado e corrigido com o nº 2, mas falta tirar dos "
         "acumulados.\n\ndisco cheio"_s,
         "3|ANL|2"},
    };
    for (const auto& [write, box, rows] : failures) {
        book.refuse(QString::fromLatin1(write), u"disco cheio"_s);
        afterwards = {.text = box, .icon = Icon::Critical, .title = caption, .partly = true};
        EXPECT_FALSE(begun.isRegistered ? again() : annul(key));
        book.refuseNoMore();
        EXPECT_EQ(stored(state), rows) << write;
        EXPECT_EQ(totals(), "150|90.5|3");
        EXPECT_EQ(caller.key, 0) << "is not called back yet";
    }
    afterwards = {};
    EXPECT_TRUE(again());
    EXPECT_EQ(stored(state), "3|ANL|2");
    EXPECT_EQ(totals(), "50|50.25|2");
    EXPECT_EQ(caller.key, key);
}

TEST_F(Annulment, ThatFailsSaysWhatIsMissingAndIsCompletedByTheNextPress) {
    failStepByStep();
    EXPECT_EQ(stored("select operacao, passo, correcao_no, tipo, concluida >= quando from "
                     "tbOperacoes"),
              "ANU|NULL|2|DOC|1");
}

TEST_F(Annulment, InABookOfAnOlderProgramIsCompletedWithoutAJournal) {
    book.exec(u"drop table tbOperacoes"_s);
    failStepByStep();
    afterwards.text = u"O movimento nº 31 já foi anulado. Nada foi gravado."_s;
    EXPECT_TRUE(annul(shown->Collect(u"movimento_id"_s).toLongLong()));
}

TEST_F(Annulment, OfAMovementThatNoAccumulatorCountsStaysUnfinished) {
    const qint64 key = document();
    book.exec(u"delete from tbSocios_Acumulados"_s);
    afterwards = {
        .text = u"Não há nenhuma linha corrente."_s, .icon = Icon::Critical, .partly = true};
    EXPECT_FALSE(annul(key));
    EXPECT_EQ(caller.key, 0);
}

}  // namespace

#include "annulment.moc"
