// SPDX-License-Identifier: MIT
// The window that makes a file for the bank, by the keys of a person.
#include <gtest/gtest.h>

#include <QAction>
#include <QDir>
#include <QLabel>
#include <QTabWidget>
#include <QTableView>

#include "host/bankfile/PayingAccount.h"
#include "host/bankfile/SentTransfers.h"
#include "host/frmPrincipal.h"
#include "platform/core/Clock.h"
#include "platform/forms/MsgBoxes.h"
#include "platform/forms/TextBox.h"
#include "tests/support/Book.h"
#include "tests/support/Failure.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

using core::Answer;

const QString Nib = u"000201231234567890154"_s;

class BankFileWindow : public testing::Test {
protected:
    BankFileWindow() {
        forms::install();
        core::setToday(QDate(2026, 3, 15));
        QDir(qEnvironmentVariable("XDG_DATA_HOME") + u"/zelmars/transferencias"_s)
            .removeRecursively();
        QFile::remove(bankfile::PayingAccount::settingsFile());
        ana = book.member({.no_kor = u"100015"_s, .nome_guerra = u"Ana D'Ávila"_s, .nib = Nib});
        const qint64 rui = book.member({.no_kor = u"100023"_s, .nome_guerra = u"Rui"_s, .nib = {}});
        pay(ana, 1, 20.5, u"2026-03-15 00:00:00"_s);
        pay(rui, 2, 30, u"2026-03-15 00:00:00"_s);
        pay(ana, 3, 7, u"2026-03-10 00:00:00"_s);
    }
    ~BankFileWindow() override { core::setToday({}); }

    void pay(qint64 member, int number, double amount, const QString& day) {
        book.insert(u"tbZelmar_Movimentos"_s, {{"movimento_no", number},
                                               {"socio_id", member},
                                               {"data", day},
                                               {"modo_pagamento", u"TRF"_s},
                                               {"debito", amount}});
    }
    /// Chooses the entry of the menu; the steps are done in its window.
    void open(const std::function<void()>& steps) {
        host::frmPrincipal window;
        window.show();
        person.onScreen(u"frmFicheiroBanco"_s, steps);
        window.findChild<QAction*>(u"FicheiroBanco"_s)->trigger();
        const auto* count = window.findChild<QLabel*>(u"Contagem"_s);
        person.waitUntil([&] { return !count->text().contains(u"a ler"_s); },
                         u"the list is read"_s);
    }
    /// What a table shows, cells parted by '|', rows by '\n'.
    QString listed(const QString& table) {
        const auto* model = person.peek<QTableView>(table)->model();
        QStringList rows;
        for (int row = 0; row < model->rowCount(); ++row) {
            QStringList cells;
            for (int column = 0; column < model->columnCount(); ++column)
                cells << model->index(row, column).data().toString();
            rows << cells.join(u'|');
        }
        return rows.join(u'\n');
    }
    void typeAccount() {
        person.fill(u"Text3"_s, u"PT50 0002 0123 1234 5678 9015 4"_s);
        person.fill(u"Text4"_s, u"Associação Tesmar"_s);
        person.fill(u"Text5"_s, u"501234567"_s);
    }
    /// "&Gravar ficheiro…", the question about the line that cannot go, the file's name, and
    /// the box at the end.
    void save(const QString& file, const support::Operator::Box& end) {
        person.expectBox({.text = u"Não podem ir: 1 transferência, € 30,00."_s,
                          .answer = Answer::Yes,
                          .partly = true});
        if (leavesOut)
            person.expectBox({.text = u"Há movimentos que já foram para um ficheiro"_s,
                              .answer = Answer::Yes,
                              .partly = true});
        person.expectBox(end);
        person.onScreen(u"QFileDialog"_s, [this, file] {
            EXPECT_TRUE(QRegularExpression(u"\\Atransferencias-20260315-\\d{4}.xml\\z"_s)
                            .match(person.peek<QLineEdit>(u"fileNameEdit"_s)->text())
                            .hasMatch());
            person.put(u"fileNameEdit"_s, file);
            person.enter();
        });
        person.accelerator(u'G');
    }

    support::Book book;
    support::Operator person;
    qint64 ana = 0;
    bool leavesOut = false;  ///< what was sent before, when a file is saved
};

}  // namespace

TEST_F(BankFileWindow, ShowsWhatGoesAndWhatCannotAndMakesTheFile) {
    const QString file = book.folder() + u"/banco.xml"_s;
    open([&] {
        EXPECT_EQ(listed(u"Table1"_s), u"100015|Ana D'Avila|PT50%1|€ 20,50|M1"_s.arg(Nib));
        EXPECT_EQ(listed(u"Table2"_s), u"100023|Rui||€ 30,00|não tem NIB"_s);
        EXPECT_EQ(person.find<QLabel>(u"Label1"_s)->text(),
                  u"Vão no ficheiro: 1 transferência, € 20,50"_s);
        // Without the account nothing is made, and a box names what is missing.
        person.expectBox({.text = u"Falta a conta que paga (NIB ou IBAN).\nFalta o nome da "
                                  "organização.\nFalta a identificação da organização."_s});
        person.accelerator(u'G');
        EXPECT_EQ(person.here()->focusWidget()->objectName(), u"Text3"_s);
        typeAccount();
        save(file, {.text = u"Ficheiro feito, com 1 transferência, € 20,50:\n"_s + file});
        EXPECT_TRUE(QFile::exists(file));
        EXPECT_TRUE(listed(u"Table3"_s).endsWith(u'|' + file + u"|1|€ 20,50|feito"_s))
            << listed(u"Table3"_s).toStdString();
        // Once more the same, over the same file and into another one.
        save(file, {.text = u"Já existe o ficheiro"_s, .partly = true});
        save(book.folder() + u"/outro.xml"_s,
             {.text = u"• 100015 Ana D'Ávila (M1): já em banco.xml, de "_s,
              .answer = Answer::No,
              .partly = true});
        EXPECT_FALSE(QFile::exists(book.folder() + u"/outro.xml"_s));
        // What is new goes alone.
        const qint64 eva =
            book.member({.no_kor = u"100031"_s, .nome_guerra = u"Eva"_s, .nib = Nib});
        pay(eva, 4, 3, u"2026-03-15 00:00:00"_s);
        person.accelerator(u'M');
        leavesOut = true;
        save(book.folder() + u"/outro.xml"_s,
             {.text = u"Ficheiro feito, com 1 transferência, € 3,00:\n"_s + book.folder() +
                      u"/outro.xml"_s});
        person.accelerator(u'F');
    });
    EXPECT_EQ(bankfile::PayingAccount::read().iban(), u"PT50"_s + Nib);
    EXPECT_EQ(bankfile::SentTransfers().files().size(), 2u);
}

TEST_F(BankFileWindow, SendsOnlyWhatWasSeen) {
    open([&] {
        typeAccount();
        person.fill(u"Text1"_s, u"10-03-2026"_s);
        person.accelerator(u'M');
        EXPECT_EQ(listed(u"Table1"_s), u"100015|Ana D'Avila|PT50%1|€ 27,50|M1-3"_s.arg(Nib));
        // Somebody posts, or the days are changed, and nothing goes that was not in sight.
        pay(ana, 4, 100, u"2026-03-12 00:00:00"_s);
        person.expectBox(
            {.text = u"As transferências não são as que estavam à vista"_s, .partly = true});
        person.accelerator(u'G');
        EXPECT_EQ(listed(u"Table1"_s), u"100015|Ana D'Avila|PT50%1|€ 127,50|M1-3-4"_s.arg(Nib));
        person.fill(u"Text1"_s, {});
        person.expectBox({.text = u"Tem de preencher os campos da data!"_s});
        person.accelerator(u'M');
        person.fill(u"Text1"_s, u"16-03-2026"_s);
        person.expectBox({.text = u"O último dia é anterior ao primeiro."_s});
        person.accelerator(u'G');
        person.escape();
    });
    EXPECT_TRUE(bankfile::SentTransfers().files().empty());
}
