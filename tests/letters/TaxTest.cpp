// SPDX-License-Identifier: MIT
// Declarations for the income tax: the query, the dialog and what is printed.
#include <QAbstractButton>
#include <QLabel>

#include "boundary/General.h"
#include "boundary/environment/dtZelmars.h"
#include "platform/forms/ListBox.h"
#include "platform/printing/Preview.h"
#include "reports/ReportRows.h"
#include "reports/TaxQuery.h"
#include "tests/entry/EntryTest.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

using core::Icon;
using environment::dtZelmars;

const QString All =
    u"SELECT ano, no_kor, nome, morada, localidade_completo, no_contribuinte,  sum(doc_valor - "
    "debito - recebido) AS tresponsabilidade ,sum(doc_valor) as tdoc_valor, sum(debito) as "
    "tcredito, sum(recebido) as trecebido From tbZelmar_Movimentos_historico WHERE (tipo='DOC' or "
    "tipo='HOS') AND ano=2003  AND ( codABC='A' OR codABC='C1' ) GROUP BY ano,no_kor,nome,morada,"
    "localidade_completo,no_contribuinte ORDER BY no_kor "_s;
const QString One =
    u"SELECT ano, no_kor, nome, morada, localidade_completo, no_contribuinte, sum(doc_valor - "
    "debito - recebido) AS tresponsabilidade, sum(doc_valor) as tdoc_valor, sum(debito) as "
    "tcredito, sum(recebido) as trecebido From tbZelmar_Movimentos_historico WHERE (tipo='DOC' or "
    "tipo='HOS') AND ano=2003  AND ( codABC='A' )  AND socio_id=7GROUP BY ano,no_kor,nome,morada,"
    "localidade_completo,no_contribuinte ORDER BY no_kor "_s;

TEST(TaxQuery, IsJoinedToTheLetter) {
    EXPECT_EQ(taxQuery({.year = u"2003"_s, .codes = {u"A"_s, u"C1"_s}}), All);
    EXPECT_EQ(taxQuery({.year = u"2003"_s, .codes = {u"A"_s}, .socio_id = 7}), One);
}

class Taxes : public entry::EntryTest {
protected:
    /// @param amounts  value of the document, the plan's share, what others paid
    void history(int year, const QString& number, const QString& tipo, const QString& code,
                 const QString& amounts, const QString& address = u"Rua do Ouro, 5"_s) {
        book.exec(
            u"insert into tbZelmar_Movimentos_Historico (ano, socio_id, no_kor, nome, morada, "
            "localidade_completo, no_contribuinte, tipo, codABC, doc_valor, debito, recebido) "
            "values (%1, %2, '%2', 'Nome de %2', '%3', '1100-060 Lisboa', '123456789', '%4', "
            "'%5', %6)"_s.arg(year)
                .arg(number, address, tipo, code, amounts));
    }
    void open(const std::function<void()>& steps) {
        person.onScreen(u"frmIRS"_s, steps);
        General().CallIRS();
        EXPECT_FALSE(person.isShown(u"frmIRS"_s));
    }
    QStringList items(const QString& name) {
        QStringList texts;
        const auto* list = person.peek<forms::ListBox>(name);
        for (int at = 0; at < list->count(); ++at) texts << list->item(at)->text();
        return texts;
    }
    /// With the keys: down to the item of a list that has the focus, and Space.
    void choose(const QString& list, const QStringList& wanted) {
        const QStringList all = items(list);
        person.find<forms::ListBox>(list)->setFocus();
        person.press(Qt::Key_Home);
        if (list == "List2"_L1) {
            person.press(Qt::Key_A, Qt::ControlModifier);
            person.press(Qt::Key_Home);
        }
        for (const QString& item : all) {
            if (wanted.contains(item) != (list == "List2"_L1)) person.press(Qt::Key_Space);
            person.press(Qt::Key_Down);
        }
        EXPECT_EQ(person.find<forms::ListBox>(list)->chosen(), wanted);
    }
    /// What the printed rows come to: number, address and the four amounts.
    QStringList printed(const QString& pages, const std::function<void()>& press = {}) {
        QStringList lines;
        person.onScreen(u"prtIRS"_s, [&] {
            person.waitUntil([&] { return person.peek<QLabel>(u"Estado"_s)->text() == pages; },
                             pages);
            const ado::RecordsetPtr rows = dtZelmars::instance().Recordsets(u"Print_Irs"_s);
            for (rows->MoveFirst(); !rows->atEnd(); rows->MoveNext()) {
                QStringList row;
                for (const auto& column : {u"no_kor"_s, u"morada"_s, u"tresponsabilidade"_s,
                                           u"tdoc_valor"_s, u"tcredito"_s, u"trecebido"_s})
                    row << rows->Collect(column).toString();
                lines << row.join(u' ');
            }
            person.escape();
        });
        press ? press() : person.accelerator(u'I');
        EXPECT_TRUE(person.find(u"Command3"_s)->hasFocus());
        return lines;
    }
};

TEST_F(Taxes, AsksForWhatIsMissingInItsOrder) {
    open([&] {
        EXPECT_EQ(items(u"List1"_s), QStringList(u"2025"_s));  // the year before, without history
        EXPECT_EQ(items(u"List2"_s).first(2), (QStringList{u"A - Titular"_s, u"B - Cônjuge"_s}));
        EXPECT_FALSE(person.peek(u"No_Kor"_s)->isEnabled());
        const auto refused = [&](const QString& text, const QString& field) {
            person.expectBox({.text = text, .icon = Icon::Information});
            person.accelerator(u'I');
            person.expectNoBoxesLeft();
            EXPECT_TRUE(person.find(field)->hasFocus()) << field.toStdString();
        };
        person.click(u"Option2"_s);
        EXPECT_FALSE(person.peek(u"Text2"_s)->isEnabled());
        refused(u"Tem de indicar um Associado para a declaração de IRS."_s, u"No_Kor"_s);
        person.click(u"Option1"_s);
        refused(u"Tem de indicar um ano de processamento."_s, u"List1"_s);
        choose(u"List1"_s, {u"2025"_s});
        refused(u"Tem de indicar pelo menos um elemento do agregado familiar."_s, u"List2"_s);
        person.escape();
    });
}

TEST_F(Taxes, DeclaresWhatAMemberBoreHimself) {
    history(2024, u"7"_s, u"DOC"_s, u"A"_s, u"100, 60, 10"_s);
    history(2024, u"7"_s, u"HOS"_s, u"C1"_s, u"1000.5, 800.25, 0"_s);
    history(2024, u"7"_s, u"PAG"_s, u"A"_s, u"500, 500, 500"_s);
    history(2024, u"7"_s, u"REP"_s, u"A"_s, u"500, 500, 500"_s);
    // Closed twice in a year, between which he moved.
    history(2024, u"8"_s, u"DOC"_s, u"A"_s, u"50, 20, 0"_s);
    history(2024, u"8"_s, u"DOC"_s, u"A"_s, u"5, 2, 0"_s, u"Rua Nova"_s);
    history(2024, u"9"_s, u"PAG"_s, u"A"_s, u"1, 1, 1"_s);
    history(2021, u"10"_s, u"DOC"_s, u"A"_s, u"1, 0, 0"_s);
    open([&] {
        EXPECT_EQ(items(u"List1"_s), (QStringList{u"2021"_s, u"2024"_s}));
        choose(u"List1"_s, {u"2024"_s});
        choose(u"List2"_s, {u"A - Titular"_s});
        const QStringList moved{u"8 Rua Nova 3 5 2 0"_s, u"8 Rua do Ouro, 5 30 50 20 0"_s};
        QStringList lines = printed(u"Página 1 de 3"_s);
        lines.sort();
        EXPECT_EQ(lines, QStringList(u"7 Rua do Ouro, 5 30 100 60 10"_s) + moved);
        choose(u"List2"_s, {u"A - Titular"_s, u"C1 - 1.º filho(a)"_s});
        lines = printed(u"Página 1 de 3"_s);
        lines.sort();
        EXPECT_EQ(lines, QStringList(u"7 Rua do Ouro, 5 230.25 1100.5 860.25 10"_s) + moved);

        person.click(u"Option2"_s);
        person.expectBox({.text = u"Número de Empresa não existe!"_s, .icon = Icon::Information});
        person.fill(u"No_Kor"_s, u"4711"_s);
        person.expectNoBoxesLeft();
        EXPECT_TRUE(person.find(u"No_Kor"_s)->hasFocus());
        person.fill(u"No_Kor"_s, u"7"_s);
        EXPECT_EQ(person.peek<forms::TextBox>(u"Text2"_s)->Text(), u"Nome de 7"_s);
        choose(u"List2"_s, {u"C1 - 1.º filho(a)"_s});
        EXPECT_EQ(printed(u"Página 1 de 1"_s),
                  QStringList(u"7 Rua do Ouro, 5 200.25 1000.5 800.25 0"_s));
        // History in another year only, and receipts only: nothing to declare.
        for (const QString& number : {u"10"_s, u"9"_s}) {
            person.fill(u"No_Kor"_s, number);
            EXPECT_EQ(printed(u"Página 1 de 1"_s), QStringList());
        }
        // Enter in the box prints for the number that stands there.
        choose(u"List2"_s, {u"A - Titular"_s});
        person.put(u"No_Kor"_s, u"7"_s);
        EXPECT_EQ(printed(u"Página 1 de 1"_s, [&] { person.enter(); }),
                  QStringList(u"7 Rua do Ouro, 5 30 100 60 10"_s));
        person.click(u"Option1"_s);  // the number stays and does not count
        choose(u"List2"_s, {u"C1 - 1.º filho(a)"_s});
        EXPECT_EQ(printed(u"Página 1 de 1"_s).size(), 1);
        person.escape();
    });
}

TEST_F(Taxes, AFailureLeavesTheWayOut) {
    history(2024, u"7"_s, u"DOC"_s, u"A"_s, u"100, 60, 10"_s);
    open([&] {
        choose(u"List1"_s, {u"2024"_s});
        choose(u"List2"_s, {u"A - Titular"_s});
        book.exec(u"alter table tbZelmar_Movimentos_Historico rename to tbHistoria"_s);
        person.expectBox({.text = {}, .icon = Icon::Critical, .partly = true});
        person.accelerator(u'I');
        person.expectNoBoxesLeft();
        EXPECT_FALSE(person.peek(u"Command3"_s)->isEnabled());
        person.accelerator(u'S');
    });
}

}  // namespace

}  // namespace reports
