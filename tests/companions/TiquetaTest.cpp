// SPDX-License-Identifier: MIT
#include <QLineEdit>

#include "tests/companions/Companion.h"

using namespace Qt::StringLiterals;

namespace {

class TiquetaTest : public CompanionTest {
protected:
    TiquetaTest() : tiqueta(companion(u"Tiqueta"_s)) {
        tiqueta.call(u"Login"_s);
        socio = book.member({.no_kor = u"100015"_s,
                             .nome = u"António Matos"_s,
                             .nib = u"0013"_s,
                             .zelmar_data_carencia = QDate(2026, 3, 31)});
    }

    void edit(const std::function<void()>& steps) {
        person.onScreen(u"frmFichaSocio"_s, steps);
        tiqueta.call(u"AbrirRegisto"_s, {QVariant::fromValue(static_cast<qint16>(socio))});
        EXPECT_FALSE(person.isShown(u"frmFichaSocio"_s));
    }
    int choose(const std::function<void()>& steps) {
        person.onScreen(u"frmEscolherFamiliar"_s, steps);
        return tiqueta.call(u"EscolherFamiliar"_s, {static_cast<int>(socio)}).toInt();
    }
    QVariant stored(const QString& column) {
        return book.value(u"select %1 from tbSocios where socio_id = %2"_s.arg(column).arg(socio));
    }
    QString field(const QString& name) { return person.find<QLineEdit>(name)->text(); }

    com::Object tiqueta;
    qint64 socio = 0;
};

class TiquetaFamily : public TiquetaTest {
protected:
    TiquetaFamily() {
        himself = book.person({.socio_id = socio,
                               .codABC = u"A"_s,
                               .nome = u"António Matos"_s,
                               .data_nascimento = QDate(1970, 5, 6)});
        wife = book.person({.socio_id = socio, .codABC = u"B"_s, .nome = u"Conceição Matos"_s});
        first = book.person({.socio_id = socio,
                             .codABC = u"C1"_s,
                             .nome = u"Rui Matos"_s,
                             .data_carencia = QDate(2026, 1, 9)});
        second = book.person({.socio_id = socio, .codABC = u"C2"_s, .nome = u"Inês Matos"_s});
        book.person({.socio_id = socio + 1, .codABC = u"A"_s, .nome = u"Estranho"_s});
    }
    qint64 himself, wife, first, second;
};

}  // namespace

TEST_F(TiquetaTest, OkWritesWhatWasChangedAndNothingElse) {
    edit([&] {
        EXPECT_TRUE(person.find<QLineEdit>(u"txtNumero"_s)->isReadOnly());
        person.fill(u"txtNib"_s, u"PT50 0013 0000 00000000001 86"_s);
        person.expectBox({.text = {}, .partly = true});
        person.fill(u"txtCarencia"_s, u"31-02-2026"_s);
        EXPECT_EQ(focus(), u"txtCarencia"_s);
        EXPECT_EQ(field(u"txtCarencia"_s), u"31-02-2026"_s);
        person.fill(u"txtCarencia"_s, u"1-2-2027"_s);
        EXPECT_EQ(field(u"txtCarencia"_s), u"01-02-2027"_s);
        person.fill(u"txtLocalidade"_s, u"Évora d'Além"_s);
        person.click(u"chkZelmar"_s);
        book.exec(u"update tbSocios set nome = 'Mudado por outro posto'"_s);
        person.accelerator(u'O');
    });
    EXPECT_EQ(stored(u"nib"_s), u"001300000000000000186"_s);
    EXPECT_EQ(stored(u"zelmar_data_carencia"_s), u"2027-02-01 00:00:00"_s);
    EXPECT_EQ(stored(u"localidade1"_s), u"Évora d'Além"_s);
    EXPECT_EQ(stored(u"zelmar"_s).toInt(), 0);
    EXPECT_EQ(stored(u"nome"_s), u"Mudado por outro posto"_s);
}

TEST_F(TiquetaTest, CancelAbandons) {
    const auto change = [&] {
        person.fill(u"txtNome"_s, u"Outro"_s);
        person.put(u"txtMorada"_s, u"Outra"_s);
        person.click(u"chkZelmar"_s);
    };
    edit([&] { change(), person.accelerator(u'C'); });
    edit([&] { change(), person.escape(); });
    edit([&] { change(), person.here()->close(); });
    EXPECT_EQ(stored(u"nome || '/' || coalesce(morada1, 'NULL') || '/' || zelmar"_s),
              u"António Matos/NULL/1"_s);
}

TEST_F(TiquetaTest, AWriteTheBookRefusesLeavesTheScreenAsItIs) {
    book.refuse(u"update on tbSocios"_s, u"o livro recusa"_s);
    edit([&] {
        person.fill(u"txtNome"_s, u"Novo Nome"_s);
        person.expectBox(
            {.text = u"o livro recusa"_s, .icon = core::Icon::Critical, .partly = true});
        person.accelerator(u'O');
        EXPECT_EQ(field(u"txtNome"_s), u"Novo Nome"_s);
        book.refuseNoMore();
        person.accelerator(u'O');
    });
    EXPECT_EQ(stored(u"nome"_s), u"Novo Nome"_s);
}

TEST_F(TiquetaFamily, OffersTheMemberAndHisRelativesAndKeysJumpAndTake) {
    const std::pair<QString, qint64> rows[] = {
        {u""_s, himself}, {u"b"_s, wife}, {u"c"_s, first}, {u"c2"_s, second}, {u"z9"_s, himself}};
    for (const auto& [typed, taken] : rows) {
        const int chosen = choose([&] {
            EXPECT_EQ(label(u"lblExplicacao"_s), u"Associado 100015, António Matos"_s);
            EXPECT_EQ(shown(u"lstFamiliares"_s),
                      u"A|Titular|António Matos|06-05-1970|31-03-2026\n"
                      "B|Cônjuge|Conceição Matos||\n"
                      "C1|1.º filho(a)|Rui Matos||09-01-2026\n"
                      "C2|2.º filho(a)|Inês Matos||"_s);
            person.type(typed);
            person.enter();
        });
        EXPECT_EQ(chosen, taken) << typed.toStdString();
    }
}
