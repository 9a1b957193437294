// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QAction>
#include <QClipboard>
#include <QFile>
#include <QFileDialog>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QStatusBar>
#include <QTemporaryDir>
#include <QVBoxLayout>

#include "host/KeptPlaces.h"
#include "host/TextTable.h"
#include "host/frmPrincipal.h"
#include "platform/forms/Form.h"
#include "platform/forms/MsgBoxes.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

class Habits : public testing::Test {
protected:
    Habits() {
        forms::install();
        const qint64 silva = book_.member({.no_kor = u"100015"_s, .nome = u"António Silva"_s});
        const qint64 other = book_.member({.no_kor = u"100023"_s, .nome = u"=Inês; \"Araújo\""_s});
        post(1, silva, u"0012"_s, 87.35);
        post(2, other, u"FT 2"_s, 12000.5);
        post(3, silva, u"FT 3"_s, -5);
    }

    void post(int number, qint64 socio_id, const QString& doc_no, double value) {
        book_.insert("tbZelmar_Movimentos", {{"movimento_no", number},
                                             {"socio_id", socio_id},
                                             {"data", QDate(2026, 11, number)},
                                             {"tipo", u"DOC"_s},
                                             {"doc_no", doc_no},
                                             {"doc_valor", value}});
    }

    void open() {
        window_ = std::make_unique<host::frmPrincipal>();
        window_->show();
        person_.screen(u"frmPrincipal"_s);
        waitFor(u"(a "_s);
    }
    /// Until the status line no longer says so.
    void waitFor(const QString& work) {
        auto* count = person_.find<QLabel>(u"Contagem"_s);
        person_.waitUntil([&] { return !count->text().contains(work); }, work);
    }
    void choose(const QString& action) { window_->findChild<QAction*>(action)->trigger(); }
    QString numbers() {
        auto* list = person_.find<QTableView>(u"Lista"_s);
        person_.waitUntil([&] { return !list->model()->index(0, 0).data().toString().isEmpty(); },
                          u"the rows are read"_s);
        QStringList numbers;
        for (int row = 0; row < list->model()->rowCount(); ++row)
            numbers << list->model()->index(row, 0).data().toString();
        return numbers.join(u' ');
    }

    support::Book book_;
    support::Operator person_;
    std::unique_ptr<host::frmPrincipal> window_;
};

/// Stands for a screen of the host.
class SomeScreen : public forms::Form {
public:
    SomeScreen() : Form(u"frmQualquer"_s, u"Ecrã"_s) {
        table = new host::TextTable(u"Grid1"_s, {{u"Nome"_s, 10}, {u"Valor"_s, 8}, {u"Dia"_s, 8}});
        table->setRows({{u"Inês"_s, u"1"_s, u"2"_s}, {u"Rui"_s, u"3"_s, u"4"_s}});
        (new QVBoxLayout(this))->addWidget(table);
        resize(400, 300);
    }
    host::TextTable* table;
};

}  // namespace

TEST_F(Habits, OrderAndFilterAreThereTheNextTimeInTheSameBook) {
    open();
    choose(u"Ordenar7"_s);
    waitFor(u"(a ordenar"_s);
    EXPECT_EQ(numbers(), u"3 1 2"_s);
    choose(u"Ordenar7"_s);
    waitFor(u"(a ordenar"_s);
    EXPECT_EQ(numbers(), u"2 1 3"_s);
    person_.put(u"Filtro"_s, u"silva"_s);
    const QColor filtered = person_.find<QLineEdit>(u"Filtro"_s)->palette().color(QPalette::Base);
    window_->hide();

    open();
    waitFor(u"(a ordenar"_s);
    EXPECT_EQ(person_.find<QLineEdit>(u"Filtro"_s)->text(), u"silva"_s);
    EXPECT_EQ(window_->statusBar()->currentMessage(),
              u"Filtro da última vez: «silva». Esc mostra todos os movimentos."_s);
    EXPECT_EQ(numbers(), u"1 3"_s);
    person_.escape();
    EXPECT_EQ(numbers(), u"2 1 3"_s);
    EXPECT_NE(person_.find<QLineEdit>(u"Filtro"_s)->palette().color(QPalette::Base), filtered);
    choose(u"OrdenarPorIdade"_s);
    EXPECT_EQ(numbers(), u"3 2 1"_s);

    // Another book's filter would leave an empty list.
    person_.put(u"Filtro"_s, u"silva"_s);
    window_->hide();
    const support::Book next;
    open();
    EXPECT_EQ(person_.find<QLineEdit>(u"Filtro"_s)->text(), QString());
    window_->hide();
}

TEST_F(Habits, TheFilteredListGoesToPaperAndToAFile) {
    open();
    person_.put(u"Filtro"_s, u"doc"_s);
    const QTemporaryDir folder;
    const QString name = folder.filePath(u"lista.csv"_s);
    person_.onScreen(u"FicheiroCsv"_s, [&] {
        person_.put(u"fileNameEdit"_s, name);
        person_.enter();
    });
    choose(u"GuardarLista"_s);
    EXPECT_EQ(window_->statusBar()->currentMessage(), u"Guardado: "_s + name);
    QFile file(name);
    ASSERT_TRUE(file.open(QFile::ReadOnly));
    EXPECT_EQ(file.readAll().toStdString(),
              "\xEF\xBB\xBF\"Nº\";\"Data\";\"Nº KOR\";\"Associado\";\"Familiar\";\"Tipo\";"
              "\"Documento\";\"Valor\";\"Crédito\";\"Débito\"\r\n"
              "3;03-11-2026;\"100015\";\"António Silva\";;\"DOC\";\"FT 3\";-5;;\r\n"
              "2;02-11-2026;\"100023\";\"'=Inês; \"\"Araújo\"\"\";;\"DOC\";\"FT 2\";12000,5;;\r\n"
              "1;01-11-2026;\"100015\";\"António Silva\";;\"DOC\";\"'0012\";87,35;;\r\n");

    choose(u"ImprimirLista"_s);
    person_.screen(u"prtMovimentos"_s);
    person_.escape();
    person_.screen(u"frmPrincipal"_s);
    person_.put(u"Filtro"_s, u"zzz"_s);
    for (const QString& way : {u"GuardarLista"_s, u"ImprimirLista"_s}) {
        choose(way);
        EXPECT_EQ(window_->statusBar()->currentMessage(), u"A lista não tem movimentos."_s);
    }
}

TEST_F(Habits, ScreensComeBackAsTheyWereLeft) {
    const host::KeptPlaces places;
    {
        SomeScreen screen;
        screen.Show();
        screen.setGeometry(50, 60, 520, 410);
        screen.table->setColumnWidth(1, 133);
        screen.Unload();
    }
    {
        SomeScreen screen;
        screen.Show();
        EXPECT_EQ(screen.geometry(), QRect(50, 60, 520, 410));
        EXPECT_EQ(screen.table->columnWidth(1), 133);
        // Hidden and shown again it stays where it is.
        screen.setGeometry(70, 80, 500, 400);
        screen.Hide();
        screen.Show();
        EXPECT_EQ(screen.geometry(), QRect(70, 80, 500, 400));
        screen.Unload();
    }
    SomeScreen larger;
    QFont font = larger.font();
    font.setPointSize(font.pointSize() * 2);
    larger.setFont(font);
    larger.Show();
    EXPECT_EQ(larger.size(), QSize(400, 300));
    larger.Unload();
}

TEST_F(Habits, RowsOfEveryTableCanBeCopied) {
    SomeScreen screen;
    screen.Show();
    person_.screen(u"frmQualquer"_s);
    screen.table->setFocus();
    screen.table->selectRow(1);
    person_.press(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QApplication::clipboard()->text(), u"Rui\t3\t4\n"_s);
    person_.press(Qt::Key_A, Qt::ControlModifier);
    person_.press(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QApplication::clipboard()->text(), u"Inês\t1\t2\nRui\t3\t4\n"_s);
    QStringList offered;
    for (const QAction* action : screen.table->actions()) offered << action->text();
    EXPECT_EQ(offered, QStringList({u"&Copiar"_s, u"Selecionar &tudo"_s}));
    screen.Unload();
}
