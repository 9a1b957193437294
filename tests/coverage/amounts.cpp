// SPDX-License-Identifier: MIT
// From the plan's share to credit and debit.
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

class Amounts : public Desk {
protected:
    coverage::Entry triedOut(const Document& document) {
        coverage::Entry entry = enter(document);
        tryOut(entry);
        return entry;
    }
};

// A relative, 100 at 80 %, franchise 10 of which 4 are spent. The ceilings leave 800 of the
// household, 500 of the relatives, 50 of the person and 20 of the person in the group.
TEST_F(Amounts, OfARelativeWithFourCeilingsAndAFranchise) {
    const qint64 group = book.rubric({.familiar = 300});
    const qint64 rubric = book.childRubric({.rubrica_id_main = group,
                                            .agregado = 1000,
                                            .familiar = 500,
                                            .total_familia = 600,
                                            .franquia = 10});
    const qint64 sister = book.childRubric({.rubrica_id_main = group});
    // The relatives' ceiling counts 100 on rows of which this person's own are more: a correction
    // of another relative makes up the difference.
    accumulated(u"B"_s, rubric, 450);
    accumulated(u"C1"_s, rubric, -350);
    accumulated(u"A"_s, rubric, 100);
    accumulated(u"B"_s, sister, -170);
    moved(rubric, 30, 26);
    const coverage::Entry entry = triedOut({.rubrica_id = rubric, .codABC = u"B"_s});
    EXPECT_EQ(kept(entry, "incidencia"), "100");
    EXPECT_EQ(kept(entry, "comparticipacao"), "80");
    EXPECT_EQ(kept(entry, "saldo_plafond"), "20");
    EXPECT_EQ(kept(entry, "iliquido"), "80");
    EXPECT_EQ(kept(entry, "liquido"), "20");
    EXPECT_EQ(kept(entry, "credito"), "14");
    EXPECT_EQ(kept(entry, "debito"), "14");
}

TEST_F(Amounts, WhatWasReceivedLowersADocumentButNotAHospitalBill) {
    const qint64 rubric = book.childRubric({});
    EXPECT_EQ(kept(triedOut({.rubrica_id = rubric, .recebido = 40}), "credito"), "60");
    coverage::Entry bill = enter({.rubrica_id = rubric, .hospital = true});
    bill.record->setCollect(u"recebido"_s, 40);
    tryOut(bill);
    EXPECT_EQ(kept(bill, "iliquido"), "80");
    EXPECT_EQ(kept(bill, "credito"), "80");
}

TEST_F(Amounts, AHospitalBillIsSharedOnItsIncidenceAndDebitedWhole) {
    const coverage::Entry bill = triedOut({.rubrica_id = book.childRubric({}),
                                           .doc_valor = 1500.5,
                                           .hospital = true,
                                           .incidencia = 1000});
    EXPECT_EQ(kept(bill, "incidencia"), "1000");
    EXPECT_EQ(kept(bill, "credito"), "800");
    EXPECT_EQ(kept(bill, "debito"), "1500.5");
    EXPECT_EQ(run.shown.Debito, bill.record->Collect(u"doc_valor"_s));
    EXPECT_EQ(kept(bill, "saldo_acumulado"), "null");
    EXPECT_FALSE(run.shown.SaldoCC);
}

TEST_F(Amounts, TheBalanceIsDebitsLessCreditsOverAllAccumulatorsOfTheMember) {
    book.exec(
        u"insert into tbSocios_Acumulados (socio_id, codABC, rubrica_id, debito_ac, credito_ac) "
        "values (%1, 'A', 900, 250, 100.5), (%1, null, 0, 40.25, null), (%2, 'A', 900, 7, 0)"_s
            .arg(socio)
            .arg(socio + 1));
    EXPECT_EQ(kept(triedOut({.rubrica_id = book.childRubric({})}), "saldo_acumulado"), "189.75");
}

TEST_F(Amounts, TheFranchiseIsSharedByTheFamilyOverEveryTypeOfMovement) {
    const qint64 rubric = book.childRubric({.franquia = 50});
    moved(rubric, 20, 5, u"HOS"_s);
    moved(rubric, 30, 25, u"DOC"_s);
    moved(rubric, {}, {}, u"PAG"_s);
    moved(rubric + 100, 1000, 0);
    EXPECT_EQ(kept(triedOut({.rubrica_id = rubric}), "credito"), "50");  // 80 - (50 - 20)
}

TEST_F(Amounts, AnAnnulledDocumentSpendsTheFranchise) {
    const qint64 rubric = book.childRubric({.franquia = 50});
    moved(rubric, 40, 30, u"ANL"_s);
    moved(rubric, {}, -30, u"COR"_s);
    EXPECT_EQ(kept(triedOut({.rubrica_id = rubric}), "credito"), "70");  // 80 - (50 - 40)
}

TEST_F(Amounts, ANegativeSpentFranchiseTakesMoreThanTheFranchise) {
    const qint64 rubric = book.childRubric({.franquia = 10});
    moved(rubric, 0, 20, u"REP"_s);
    EXPECT_EQ(kept(triedOut({.rubrica_id = rubric}), "credito"), "50");  // 80 - (10 + 20)
}

TEST_F(Amounts, MovementsWithoutNetAmountsSpendNoFranchise) {
    const qint64 rubric = book.childRubric({.franquia = 10});
    moved(rubric, {}, 20, u"COR"_s);
    EXPECT_EQ(kept(triedOut({.rubrica_id = rubric}), "credito"), "70");
}

TEST_F(Amounts, ANegativeNetAmountIsCreditedOnlyWhenNothingOfTheFranchiseIsLeft) {
    const qint64 rubric = book.childRubric({.franquia = 5});
    const Document document{.rubrica_id = rubric, .recebido = 120};
    EXPECT_EQ(kept(triedOut(document), "liquido"), "-20");
    EXPECT_EQ(kept(triedOut(document), "credito"), "0");
    moved(rubric, 5, 0);
    EXPECT_EQ(kept(triedOut(document), "credito"), "-20");
}

TEST_F(Amounts, AreNotRoundedToCents) {
    const qint64 rubric = book.childRubric({.percent = 0.7});
    EXPECT_EQ(kept(triedOut({.rubrica_id = rubric, .doc_valor = 33.33}), "credito"), "23.331");
}

// A 32-bit float has steps of 1/128 between 65536 and 131072: 123456.78 becomes 123456.78125, of
// which a column keeps four decimals.
TEST_F(Amounts, PassThroughSinglePrecision) {
    const qint64 rubric = book.childRubric({.percent = 1});
    const coverage::Entry entry = triedOut(
        {.rubrica_id = rubric, .doc_valor = 123456.78, .hospital = true, .incidencia = 123456.78});
    EXPECT_EQ(kept(entry, "comparticipacao"), "123456.78");
    EXPECT_EQ(kept(entry, "iliquido"), "123456.7813");
    EXPECT_EQ(kept(entry, "debito"), "123456.7813");
}

}  // namespace
