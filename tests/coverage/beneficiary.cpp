// SPDX-License-Identifier: MIT
// Who may have a document processed, and the VAT in its value, beyond what the screen shows. Today
// is 15 May 2026.
#include "entry/Beneficiary.h"

#include "entry/DocumentVat.h"
#include "platform/core/Clock.h"
#include "tests/coverage/Desk.h"

using namespace Qt::StringLiterals;
using core::Answer;
using core::Icon;

namespace {

class Beneficiary : public Desk {};

TEST_F(Beneficiary, ThePremiumOfTheYearMayBePaidAheadButNotTooMuch) {
    const struct {
        QDate today;
        int year, month, paid;
        const char* box;
    } rows[] = {
        {{2026, 5, 15}, 2026, 12, 120, nullptr},
        {{2026, 12, 31}, 2026, 11, 120, nullptr},
        {{2026, 1, 1}, 2026, 1, 120, nullptr},
        {{2026, 5, 15},
         2026,
         4,
         121,
         "Este Associado o prémio de zelmar (quotizações do Plano de Saúde) por liquidar."},
    };
    for (const auto& row : rows) {
        core::setToday(row.today);
        book.exec(u"delete from tbQuotas_Socios"_s);
        book.insert(u"tbQuotas_Socios"_s, {{"socio_id", socio},
                                           {"ult_ano", row.year},
                                           {"ult_mes", row.month},
                                           {"total_quotas", 120},
                                           {"total_pago", row.paid}});
        if (row.box) boxes.expect(QString::fromUtf8(row.box), Icon::Critical);
        boxes.ask(u"Quer ver o extrato de quotizações deste Associado?"_s, Icon::Exclamation,
                  u"Quotizações"_s, Answer::No);
        EXPECT_FALSE(entry::testPremium(socio));
    }
}

TEST_F(Beneficiary, OnlyAZeroMeansThatAMemberIsNotEnrolled) {
    for (const int zelmar : {1, -1, 2}) {
        book.exec(u"update tbSocios set zelmar = %1"_s.arg(zelmar));
        EXPECT_TRUE(entry::checkEnrolled(*entry::openMemberByNumber(u"100015"_s)));
    }
    book.exec(u"update tbSocios set zelmar = 0"_s);
    boxes.expect(u"Este Associado não está inscrito no plano de Saúde."_s, Icon::Critical);
    EXPECT_FALSE(entry::checkEnrolled(*entry::openMemberById(socio)));
}

// The child's letter counts first, wherever it stands.
TEST_F(Beneficiary, ACodeWithBothLettersIsAChilds) {
    const QDate today = core::today();
    for (const QString& code : {u"AC"_s, u"cA"_s}) {
        const auto child = [&](int days) {
            return book.person(
                {.socio_id = socio, .codABC = code, .data_nascimento = today.addDays(-days)});
        };
        EXPECT_TRUE(entry::admitPerson(child(9131), socio));
        boxes.expect(u"Este familiar tem mais de 25 anos! Tente indicar outro."_s,
                     Icon::Information, u"Familiares"_s);
        EXPECT_FALSE(entry::admitPerson(child(9132), socio));
    }
}

// A missing row looks up as empty text, which is neither null nor a day that has passed.
TEST_F(Beneficiary, APersonWhoseRowIsGoneIsRefused) {
    boxes.expect(
        u"Este familiar está dentro do periodo de carência! Não pode ser processado o documento."_s,
        Icon::Information, u"Periodo de Carência"_s);
    EXPECT_FALSE(entry::admitPerson(99999, socio));
}

TEST_F(Beneficiary, AMemberWhoHasLeftIsRefused) {
    const qint64 id = book.person({.socio_id = socio, .codABC = u"A"_s});
    book.exec(u"delete from tbSocios"_s);
    boxes.expect(
        u"O Associado está dentro do periodo de carência! Não pode ser processado o documento."_s,
        Icon::Information, u"Periodo de Carência"_s);
    EXPECT_FALSE(entry::admitPerson(id, socio));
}

TEST(DocumentVat, IsTheTaxContainedInTheValueToTheCent) {
    EXPECT_DOUBLE_EQ(entry::vatOf(123.0F, 5), 5.86);    // 123 - 117.142857
    EXPECT_DOUBLE_EQ(entry::vatOf(87.35F, 23), 16.33);  // 87.35 - 71.016260
    EXPECT_DOUBLE_EQ(entry::vatOf(100.0F, 0.5), 0.5);   // 100 - 99.502488
    EXPECT_DOUBLE_EQ(entry::vatOf(0.25F, 100), 0.12);   // 12.5 cents, to the even neighbour
    EXPECT_DOUBLE_EQ(entry::vatOf(-123.0F, 5), -5.86);
    EXPECT_DOUBLE_EQ(entry::vatOf(41943040.0F, 100), 20971520.0);
    EXPECT_EQ(failureOf([] { entry::vatOf(1e9F, 100); }), core::Overflow);
}

}  // namespace
