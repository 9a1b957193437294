// SPDX-License-Identifier: MIT
// The member's page, opened from the list of movements.
#include <gtest/gtest.h>

#include <QClipboard>
#include <QComboBox>
#include <QTableView>

#include "coverage/Remainders.h"
#include "host/BookSettings.h"
#include "host/RemainderList.h"
#include "host/RulesConnection.h"
#include "host/frmPrincipal.h"
#include "platform/com/Component.h"
#include "platform/forms/MsgBoxes.h"
#include "platform/forms/TextBox.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

/// Stands for the component and for the search over the members.
class Asked : public QObject {
    Q_OBJECT
public:
    static inline QStringList calls;
    static inline int found = 0;
    Q_INVOKABLE void Registo(const QVariant&, const QVariant& key, QString* = nullptr,
                             QString* = nullptr, QObject* = nullptr) {
        calls << u"Registo %1"_s.arg(key.toInt());
    }
    Q_INVOKABLE void Login() {}
    Q_INVOKABLE int FindSocios() { return found; }
};

class AccountPage : public testing::Test {
protected:
    AccountPage() {
        forms::install();
        for (const QString& name : {u"Zelmars.General"_s, u"Tiqueta.General"_s})
            com::registerRunning(name, [] { return new Asked; });
        Asked::calls.clear();
        member_ = book_.member({.no_kor = u"100015"_s, .nome = u"António Silva"_s});
        book_.person({.socio_id = member_, .codABC = u"C1"_s, .nome = u"Rui Silva"_s});
        const qint64 main = book_.rubric({});
        rubric_ = book_.childRubric({.rubrica_id_main = main});
        book_.exec(
            u"update tbZelmar_Plafonds set code='0101', descrit='Consultas', socio=500, "
            "familiar=200, total_familia=150, nomax_recibos_familiar=3, franquia=25 "
            "where rubrica_id=%1"_s.arg(rubric_));
        accumulate(u"A"_s, 120.5, 2);
        accumulate(u"C1"_s, 40, 3);
        book_.insert("tbZelmar_Movimentos", {{"movimento_no", 7},
                                             {"socio_id", member_},
                                             {"codABC", u"A"_s},
                                             {"rubrica_id", rubric_},
                                             {"data", QDate(2026, 11, 20)},
                                             {"tipo", u"DOC"_s},
                                             {"doc_valor", 87.35},
                                             {"liquido", 30},
                                             {"credito", 20}});
        window_.show();
        person_.screen(u"frmPrincipal"_s);
        person_.waitUntil(
            [&] { return person_.find<QTableView>(u"Lista"_s)->model()->rowCount() == 1; },
            u"the list is read"_s);
    }
    ~AccountPage() override {
        for (const QString& name : {u"Zelmars.General"_s, u"Tiqueta.General"_s})
            com::registerRunning(name, {});
    }
    void accumulate(const QString& codABC, double amount, int documents) {
        book_.insert(
            "tbSocios_Acumulados",
            {{"socio_id", member_},
             {"codABC", codABC},
             {"rubrica_id", rubric_},
             {"rubrica_id_main", book_
                                     .text(u"select rubrica_id_main from tbZelmar_Plafonds where "
                                           "rubrica_id=%1"_s.arg(rubric_))
                                     .toInt()},
             {"debito_ac", amount + 10},
             {"credito_ac", amount},
             {"no_docs", documents}});
    }
    std::string row(const QString& grid, int row) {
        const QAbstractItemModel* model = person_.find<QTableView>(grid)->model();
        QStringList cells;
        for (int column = 0; column < model->columnCount(); ++column)
            cells << model->index(row, column).data().toString();
        return cells.join(u'|').remove(u"€ "_s).toStdString();
    }
    std::string box(const QString& name) {
        return person_.find<forms::TextBox>(name)->Text().toStdString();
    }

    support::Book book_;
    qint64 member_ = 0;
    qint64 rubric_ = 0;
    support::Operator person_;
    host::frmPrincipal window_;
};

TEST_F(AccountPage, ShowsTheMemberOfTheMovementAndWhatIsLeftToEachPerson) {
    person_.press(Qt::Key_M, Qt::ControlModifier);
    person_.screen(u"frmConta"_s);
    EXPECT_EQ(box(u"Text1"_s), "100015");
    EXPECT_EQ(box(u"Text2"_s), "António Silva");
    EXPECT_EQ(box(u"Text8"_s), "€ 20,00") << "the balance: debits less credits";
    EXPECT_NE(box(u"Text5"_s).find("ainda não liquidou nenhum prémio"), std::string::npos);
    EXPECT_EQ(row(u"Grid1"_s, 0), "7|20-11-2026|A|DOC||87,35|20,00|");
    EXPECT_EQ(row(u"Grid2"_s, 0),
              "0101  -  Consultas|379,50|Rubrica: o próprio|500,00|120,50|||15,00");
    person_.find<QComboBox>(u"Combo1"_s)->setCurrentIndex(1);
    EXPECT_EQ(
        row(u"Grid2"_s, 0),
        "0101  -  Consultas|documentos esgotados|Rubrica: os familiares|150,00|40,00||0|15,00");

    person_.click(u"Grid1"_s);
    person_.find<QTableView>(u"Grid1"_s)->selectRow(0);
    person_.enter();
    EXPECT_EQ(Asked::calls.join(u' '),
              u"Registo "_s + book_.text(u"select movimento_id from tbZelmar_Movimentos"_s));
    person_.escape();
    EXPECT_FALSE(person_.isShown(u"frmConta"_s));
}

TEST_F(AccountPage, OfAMemberWhoWasSearchedForTakesThePlaceOfTheLast) {
    const qint64 other = book_.member({.no_kor = u"100023"_s, .nome = u"Inês Araújo"_s});
    person_.press(Qt::Key_M, Qt::ControlModifier);
    person_.screen(u"frmConta"_s);
    person_.screen(u"frmPrincipal"_s);
    Asked::found = static_cast<int>(other);
    person_.press(Qt::Key_M, Qt::ControlModifier | Qt::ShiftModifier);
    person_.screen(u"frmConta"_s);
    EXPECT_EQ(box(u"Text1"_s), "100023");
    EXPECT_EQ(person_.find<QTableView>(u"Grid1"_s)->model()->rowCount(), 0);
    Asked::found = 99;
    person_.screen(u"frmPrincipal"_s);
    person_.expectBox({.text = u"Este associado não se encontra na tabela de activos."_s});
    person_.press(Qt::Key_M, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_TRUE(person_.isShown(u"frmConta"_s)) << "the page that was open stays";
}

TEST_F(AccountPage, IsPrintedWithARowForEachPersonAndRubric) {
    const host::RulesConnection connection(host::BookSettings::read());
    const coverage::Remainders left(static_cast<qint32>(member_));
    const ado::RecordsetPtr rows =
        host::remainderRows({{u"A"_s, u"António Silva"_s, left.of(u"A"_s)},
                             {u"C1"_s, u"Rui Silva"_s, left.of(u"C1"_s)}});
    EXPECT_EQ(rows->RecordCount(), 2);
    EXPECT_EQ(rows->Collect(u"resta"_s), u"€ 379,50"_s);
    rows->MoveNext();
    EXPECT_EQ(rows->Collect(u"pessoa"_s), u"C1"_s);
    EXPECT_EQ(rows->Collect(u"resta"_s), u"documentos esgotados"_s);
}

}  // namespace

#include "AccountPageTest.moc"
