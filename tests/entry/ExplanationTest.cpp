// SPDX-License-Identifier: MIT
// F2 on the entry screen: why an amount is what it is.
#include <QLabel>
#include <QTableWidget>

#include "platform/core/Values.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

class WhyThisAmount : public EntryTest {
protected:
    void setRubric(const QString& column, const QString& value) {
        book.exec(u"update tbZelmar_Plafonds set %1 = %2 where rubrica_id = %3"_s.arg(column, value)
                      .arg(rubric));
    }
    void tryOutAndAsk(const QList<support::Operator::Box>& refusals = {}) {
        for (const auto& box : refusals) person.expectBox(box);
        person.press(Qt::Key_F9);
        ask();
    }
    /// F2, what the list shows then, and Esc.
    void ask() {
        shown.clear();
        person.onScreen(u"frmExplicacao"_s, [this] {
            auto* grid = person.find<QTableWidget>(u"Grid1"_s);
            inShort = person.peek<QLabel>(u"Label2"_s)->text();
            for (int row = 0; row < grid->rowCount(); ++row) {
                QStringList cells;
                for (int column = 0; column < grid->columnCount(); ++column)
                    cells << grid->item(row, column)->text();
                shown << cells.join(u'|').remove(u"€ "_s);
            }
            person.escape();
        });
        person.press(Qt::Key_F2);
    }
    std::string lines() const { return shown.join(u'\n').toStdString(); }

    QStringList shown;
    QString inShort;
};

TEST_F(WhyThisAmount, IsToldInTheOrderOfTheTryOutAndChangesNothing) {
    const qint64 main =
        book.text(u"select rubrica_id_main from tbZelmar_Plafonds where rubrica_id = %1"_s.arg(
                      rubric))
            .toLongLong();
    book.exec(u"update tbZelmar_Plafonds set agregado = 300 where rubrica_id = %1"_s.arg(main));
    setRubric(u"franquia"_s, u"10"_s);
    setRubric(u"nomax_recibos_socio"_s, u"5"_s);
    book.insert(u"tbSocios_Acumulados"_s, {{"socio_id", socio},
                                           {"codABC", "A"},
                                           {"rubrica_id", rubric},
                                           {"rubrica_id_main", main},
                                           {"debito_ac", 280},
                                           {"credito_ac", 280},
                                           {"no_docs", 2}});
    openNew();
    typeDocument(u"100"_s, u"20"_s);
    tryOutAndAsk();
    EXPECT_EQ(inShort.toStdString(),
              "O plano paga € 10,00: limitou o plafond «Rubrica principal: todo o agregado», menos "
              "o resto da franquia.");
    EXPECT_EQ(lines(),
              "Valor do documento|100,00||\n"
              "Comparticipação, antes dos plafonds (75 %)|75,00||\n"
              "Rubrica: o próprio|500,00|280,00|220,00\n"
              "Rubrica principal: todo o agregado  ◄ foi este que limitou|300,00|280,00|20,00\n"
              "Número de documentos|5|2|3\n"
              "Recebido de outra entidade|20,00||\n"
              "Ilíquido|75,00||\n"
              "Líquido, depois dos plafonds|20,00||\n"
              "Franquia, que fica a cargo do associado|10,00|0,00|10,00\n"
              "Crédito|10,00||\n"
              "Débito|10,00||");
    EXPECT_TRUE(form().isVisible());
    EXPECT_EQ(core::toDouble(pending(u"credito"_s)), 10);
    EXPECT_EQ(form().focusWidget()->objectName(), u"Command5"_s) << "where the focus was";
}

TEST_F(WhyThisAmount, IsToldOnlyOfTheTryOutThatTheScreenShows) {
    openNew();
    person.expectBox({.text = u"Ainda não há ensaio. Faça o ensaio (F9); F2 diz então porquê."_s});
    person.press(Qt::Key_F2);
    typeDocument(u"100"_s);
    tryOutAndAsk();
    EXPECT_EQ(inShort,
              u"O plano paga € 75,00: é a comparticipação inteira, nenhum plafond limitou."_s);
    person.put(u"Text6"_s, u"200"_s);
    person.expectBox(
        {.text =
             u"O documento mudou depois do ensaio. Faça o ensaio de novo (F9), e depois F2."_s});
    person.press(Qt::Key_F2);
    EXPECT_EQ(person.here()->focusWidget()->objectName(), u"Text6"_s);
    EXPECT_EQ(form().Text6->Text(), u"200"_s);
    tryOutAndAsk();
    EXPECT_TRUE(inShort.startsWith(u"O plano paga € 150,00"_s)) << inShort.toStdString();
}

TEST_F(WhyThisAmount, OfARefusalIsWhatRefused) {
    openNew();
    typeDocument(u"100"_s);
    setRubric(u"socio_min_lan"_s, u"150"_s);
    tryOutAndAsk({{.text = u"Este lançamento tem um limite minimo de € 150,00"_s}});
    EXPECT_EQ(inShort, u"O documento não chega ao mínimo da rubrica."_s);
    EXPECT_EQ(lines(), "Valor do documento|100,00||\nMínimo por documento|150,00||");

    setRubric(u"socio_min_lan"_s, u"null"_s);
    setRubric(u"nomax_recibos_socio"_s, u"0"_s);
    tryOutAndAsk({{.text = u"O limite máximo do nº de documentos foi atingido."_s}});
    EXPECT_EQ(inShort, u"O número de documentos da rubrica está esgotado."_s);
    EXPECT_EQ(shown.last(), u"Número de documentos|0|0|0"_s);
}

}  // namespace

}  // namespace entry
