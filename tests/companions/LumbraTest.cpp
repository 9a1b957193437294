// SPDX-License-Identifier: MIT
#include "platform/registry/Registry.h"
#include "tests/companions/Companion.h"

using namespace Qt::StringLiterals;

namespace {

class LumbraTest : public CompanionTest {
protected:
    LumbraTest() : lumbra(companion(u"Lumbra"_s)) {
        ines = book.member({.no_kor = u"200001"_s,
                            .nome = u"Inês da Conceição Sá"_s,
                            .nome_guerra = u"Inês Sá"_s,
                            .zelmar = 0,
                            .localidade1 = u"Évora"_s});
        joao = book.member({.no_kor = u"100020"_s, .nome = u"João Sá Carneiro"_s});
        luis = book.member({.no_kor = u"100021"_s, .nome = u"Luís Antunes"_s});
        lumbra.call(u"Login"_s, {u"zelmars"_s, u""_s});
    }

    /// Searches; the person does the steps in the window.
    int search(const std::function<void()>& steps) {
        person.onScreen(u"frmProcurar"_s, steps);
        return lumbra.call(u"appShow"_s, {u"SOC01"_s, false}).toInt();
    }
    com::Object lumbra;
    qint64 ines, joao, luis;
};

QVariantList premiumsOf(const QString& condition) {
    return {u"QUO01"_s, 1, QVariant(), u"Activos"_s, condition, true, true};
}

}  // namespace

TEST_F(LumbraTest, SearchFindsWhileTypingAndEnterTakes) {
    const int taken = search([&] {
        EXPECT_EQ(focus(), u"txtProcurar"_s);
        EXPECT_EQ(label(u"lblEncontrados"_s), u"3 de 3 associados"_s);
        person.type(u"conceicao i"_s);
        EXPECT_EQ(shown(u"lstSocios"_s), u"200001|Inês da Conceição Sá|Inês Sá|Évora|Não"_s);
        EXPECT_EQ(label(u"lblEncontrados"_s), u"1 de 3 associados"_s);
        person.enter();
    });
    EXPECT_EQ(taken, ines);
    EXPECT_FALSE(person.isShown(u"frmProcurar"_s));
}

TEST_F(LumbraTest, ArrowsMoveTheListWhileTheFocusStaysInTheField) {
    EXPECT_EQ(search([&] {
                  person.type(u"1000"_s);
                  person.press(Qt::Key_Down);
                  EXPECT_EQ(focus(), u"txtProcurar"_s);
                  person.press(Qt::Key_Up);
                  person.press(Qt::Key_Down);
                  person.enter();
              }),
              luis);
}

TEST_F(LumbraTest, GivingUpIsZero) {
    EXPECT_EQ(search([&] { person.escape(); }), 0);
    EXPECT_EQ(search([&] { person.accelerator(u'D'); }), 0);
    EXPECT_EQ(search([&] { person.here()->close(); }), 0);
    EXPECT_EQ(search([&] {
                  person.type(u"ninguém'; --"_s);
                  person.enter();
                  EXPECT_TRUE(person.isShown(u"frmProcurar"_s)) << "nothing there to be taken";
                  person.escape();
              }),
              0);
}

TEST_F(LumbraTest, F5ReadsTheMembersAnew) {
    qint64 late = 0;
    EXPECT_EQ(search([&] {
                  person.type(u"rita"_s);
                  EXPECT_EQ(shown(u"lstSocios"_s), QString());
                  late = book.member({.no_kor = u"300001"_s, .nome = u"Rita Pó"_s});
                  person.press(Qt::Key_F5);
                  person.settle();
                  EXPECT_EQ(label(u"lblEncontrados"_s), u"1 de 4 associados"_s);
                  person.enter();
              }),
              late);
}

TEST_F(LumbraTest, PremiumStatementStaysWhileTheObjectIsKept) {
    for (const int month : {1, 3, 2})
        book.insert("tbQuotas_Movimentos", {{"socio_id", ines},
                                            {"data", QDate(2026, month, 15)},
                                            {"ano", 2026},
                                            {"mes", month},
                                            {"valor", 12.5},
                                            {"descrit", u"Prémio"_s}});
    book.insert("tbQuotas_Movimentos", {{"socio_id", joao}, {"valor", 99}});
    book.insert("tbQuotas_Socios", {{"socio_id", ines},
                                    {"ult_ano", 2026},
                                    {"ult_mes", 3},
                                    {"total_quotas", 50},
                                    {"total_pago", 37.5}});
    lumbra.call(u"appShow"_s, premiumsOf(u"tbQuotas_Movimentos.socio_id=%1"_s.arg(ines)));
    person.screen(u"frmQuotas"_s);
    EXPECT_FALSE(person.here()->isModal());
    EXPECT_EQ(label(u"lblAssociado"_s), u"Associado 200001, Inês da Conceição Sá"_s);
    EXPECT_EQ(shown(u"DataGrid1"_s),
              u"15-03-2026|2026|3|€ 12,50|Prémio\n"
              "15-02-2026|2026|2|€ 12,50|Prémio\n"
              "15-01-2026|2026|1|€ 12,50|Prémio"_s);
    EXPECT_EQ(label(u"lblTotais"_s), u"Pagamentos: 3    Total: € 37,50"_s);
    EXPECT_TRUE(label(u"lblSituacao"_s).contains(u"3/2026"_s));
    EXPECT_TRUE(label(u"lblSituacao"_s).contains(u"€ 50,00"_s));
    lumbra = {};
    EXPECT_FALSE(person.isShown(u"frmQuotas"_s));
}

TEST_F(LumbraTest, PremiumStatementOfOneWhoNeverPaidStillNamesHim) {
    lumbra.call(u"appShow"_s, premiumsOf(u"tbQuotas_Movimentos.socio_id=%1"_s.arg(joao)));
    person.screen(u"frmQuotas"_s);
    EXPECT_EQ(label(u"lblAssociado"_s), u"Associado 100020, João Sá Carneiro"_s);
    EXPECT_EQ(label(u"lblTotais"_s), u"Pagamentos: 0    Total: € 0,00"_s);
    person.escape();
    EXPECT_FALSE(person.isShown(u"frmQuotas"_s));
}

TEST_F(LumbraTest, AFailingConditionGivesTheEnginesText) {
    const auto unknown = failureOf(lumbra, u"appShow"_s, premiumsOf(u"nada=1"_s));
    EXPECT_EQ(unknown.number(), core::DatabaseFailure);
    EXPECT_TRUE(unknown.text().contains(u"nada"_s)) << unknown.what();
    const auto quote = failureOf(lumbra, u"appShow"_s, premiumsOf(u"descrit='d'Almeida'"_s));
    EXPECT_NE(quote.number(), 0);
    EXPECT_NE(quote.text(), QString());
    EXPECT_FALSE(person.isShown(u"frmQuotas"_s));
}

TEST_F(LumbraTest, WrongUseIsAFailureWithAText) {
    EXPECT_TRUE(failureOf(lumbra, u"appShow"_s, {u"XYZ"_s}).text().contains(u"«XYZ»"_s));
    EXPECT_EQ(failureOf(companion(u"Lumbra"_s), u"appShow"_s, {u"SOC01"_s, false}).number(),
              core::InvalidCall)
        << "before Login";
    registry::removeKey(registry::Hive::LocalMachine, u"SOFTWARE\\Norvanta\\Corvenda"_s);
    EXPECT_TRUE(
        failureOf(lumbra, u"Login"_s, {u"zelmars"_s, u""_s}).text().contains(u"dtSecurityInfo"_s));
}
