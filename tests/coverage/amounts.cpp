// SPDX-License-Identifier: MIT
// From the plan's share to credit and debit.
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;

namespace {

class Amounts : public Desk {
protected:
    coverage::Entry triedOut(const Document& document) {
        const coverage::Entry entry = enter(document);
        tryOut(entry);
        return entry;
    }
    static void expectAmounts(const coverage::Entry& entry,
                              std::initializer_list<std::pair<const char*, const char*>> amounts) {
        for (const auto& [column, amount] : amounts)
            EXPECT_EQ(kept(entry, column), amount) << column;
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
    expectAmounts(triedOut({.rubrica_id = rubric, .codABC = u"B"_s}), {{"incidencia", "100"},
                                                                       {"comparticipacao", "80"},
                                                                       {"saldo_plafond", "20"},
                                                                       {"iliquido", "80"},
                                                                       {"liquido", "20"},
                                                                       {"credito", "14"},
                                                                       {"debito", "14"}});
}

TEST_F(Amounts, AHospitalBillIsSharedOnItsIncidenceAndDebitedWhole) {
    coverage::Entry bill = enter({.rubrica_id = book.childRubric({}),
                                  .doc_valor = 1500.5,
                                  .hospital = true,
                                  .incidencia = 1000});
    bill.record->setCollect(u"recebido"_s, 40);  // lowers a document, but not a bill
    tryOut(bill);
    expectAmounts(bill, {{"incidencia", "1000"},
                         {"iliquido", "800"},
                         {"credito", "800"},
                         {"debito", "1500.5"},
                         {"saldo_acumulado", "null"}});
    EXPECT_EQ(run.shown.Debito, bill.record->Collect(u"doc_valor"_s));
    EXPECT_FALSE(run.shown.SaldoCC);
}

TEST_F(Amounts, TheBalanceIsDebitsLessCreditsOverAllAccumulatorsOfTheMember) {
    book.exec(
        u"insert into tbSocios_Acumulados (socio_id, codABC, rubrica_id, debito_ac, credito_ac) "
        "values (%1, 'A', 900, 250, 100.5), (%1, null, 0, 40.25, null), (%2, 'A', 900, 7, 0)"_s
            .arg(socio)
            .arg(socio + 1));
    expectAmounts(triedOut({.rubrica_id = book.childRubric({}), .recebido = 40}),
                  {{"saldo_acumulado", "189.75"}, {"iliquido", "60"}, {"credito", "60"}});
}

TEST_F(Amounts, ANegativeNetAmountIsCreditedOnlyWhenNothingOfTheFranchiseIsLeft) {
    const qint64 rubric = book.childRubric({.franquia = 5});
    const Document document{.rubrica_id = rubric, .recebido = 120};
    expectAmounts(triedOut(document), {{"liquido", "-20"}, {"credito", "0"}});
    moved(rubric, 5, 0);
    expectAmounts(triedOut(document), {{"liquido", "-20"}, {"credito", "-20"}, {"debito", "0"}});
}

// A 32-bit float has steps of 1/128 between 65536 and 131072: 123456.78 becomes 123456.78125, of
// which a column keeps four decimals.
TEST_F(Amounts, PassThroughSinglePrecisionAndAreNotRoundedToCents) {
    expectAmounts(triedOut({.rubrica_id = book.childRubric({.percent = 0.7}), .doc_valor = 33.33}),
                  {{"credito", "23.331"}});
    expectAmounts(
        triedOut({.rubrica_id = book.childRubric({.percent = 1}), .doc_valor = 123456.78}),
        {{"comparticipacao", "123456.78"}, {"iliquido", "123456.7813"}});
}

}  // namespace
