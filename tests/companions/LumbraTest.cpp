// SPDX-License-Identifier: MIT
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
        lumbra.call(u"Login"_s, {book.user(), u""_s});
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

TEST_F(LumbraTest, SearchFindsWhileTypingAndKeysMoveAndTake) {
    const int found = search([&] {
        EXPECT_EQ(focus(), u"txtProcurar"_s);
        person.type(u"conceicao i"_s);
        EXPECT_EQ(shown(u"lstSocios"_s), u"200001|Inês da Conceição Sá|Inês Sá|Évora|Não"_s);
        EXPECT_EQ(label(u"lblEncontrados"_s), u"1 de 3 associados"_s);
        person.enter();
    });
    EXPECT_EQ(found, ines);
    const qint64 whole = book.member({.no_kor = u"10002"_s, .nome = u"Zulmira Paz"_s});
    const int typedInFull = search([&] {
        person.type(u"10002"_s);
        person.enter();
    });
    EXPECT_EQ(typedInFull, whole);
    const int moved = search([&] {
        person.type(u"10002"_s);
        person.press(Qt::Key_Down);
        person.press(Qt::Key_Down);
        EXPECT_EQ(focus(), u"txtProcurar"_s);
        person.enter();
    });
    EXPECT_EQ(moved, luis);
    qint64 late = 0;
    const int readAnew = search([&] {
        person.type(u"rita"_s);
        late = book.member({.no_kor = u"300001"_s, .nome = u"Rita Pó"_s});
        person.enter();
        EXPECT_TRUE(person.isShown(u"frmProcurar"_s)) << "nothing there to be taken";
        person.press(Qt::Key_F5);
        person.enter();
    });
    EXPECT_EQ(readAnew, late);
}

TEST_F(LumbraTest, GivingUpIsZero) {
    EXPECT_EQ(search([&] { person.escape(); }), 0);
    EXPECT_EQ(search([&] { person.accelerator(u'D'); }), 0);
    EXPECT_EQ(search([&] { person.here()->close(); }), 0);
}

TEST_F(LumbraTest, PremiumStatementStaysWhileTheObjectIsKept) {
    for (const int month : {1, 2})
        book.insert("tbQuotas_Movimentos", {{"socio_id", ines},
                                            {"data", QDate(2026, month, 15)},
                                            {"ano", 2026},
                                            {"mes", month},
                                            {"valor", 12.5},
                                            {"descrit", u"Prémio"_s}});
    book.insert("tbQuotas_Movimentos", {{"socio_id", joao + 1}, {"valor", 99}});
    book.premiumInOrder(ines);
    lumbra.call(u"appShow"_s, premiumsOf(u"tbQuotas_Movimentos.socio_id=%1"_s.arg(ines)));
    person.screen(u"frmQuotas"_s);
    EXPECT_FALSE(person.here()->isModal());
    EXPECT_EQ(label(u"lblAssociado"_s), u"Associado 200001, Inês da Conceição Sá"_s);
    EXPECT_EQ(shown(u"DataGrid1"_s),
              u"15-02-2026|2026|2|€ 12,50|Prémio\n15-01-2026|2026|1|€ 12,50|Prémio"_s);
    EXPECT_EQ(label(u"lblTotais"_s), u"Pagamentos: 2    Total: € 25,00"_s);
    EXPECT_TRUE(label(u"lblSituacao"_s).contains(u"€ 120,00"_s));
    // Of one who never paid.
    lumbra.call(u"appShow"_s, premiumsOf(u"tbQuotas_Movimentos.socio_id=%1"_s.arg(joao)));
    person.screen(u"frmQuotas"_s);
    EXPECT_EQ(label(u"lblAssociado"_s), u"Associado 100020, João Sá Carneiro"_s);
    EXPECT_EQ(label(u"lblTotais"_s), u"Pagamentos: 0    Total: € 0,00"_s);
    lumbra = {};
    EXPECT_FALSE(person.isShown(u"frmQuotas"_s));
}
