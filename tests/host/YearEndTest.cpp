// SPDX-License-Identifier: MIT
// What the window does before a close, and beside it.
#include <gtest/gtest.h>

#include <QAction>
#include <QLabel>
#include <QPlainTextEdit>
#include <QProcess>
#include <QTableView>

#include "host/frmPrincipal.h"
#include "platform/com/Component.h"
#include "platform/forms/MsgBoxes.h"
#include "platform/forms/TextBox.h"
#include "tests/support/Book.h"
#include "tests/support/Operator.h"

using namespace Qt::StringLiterals;

namespace {

/// Stands for the component: notes that the close was opened.
class Closing : public QObject {
    Q_OBJECT
public:
    static inline int calls = 0;
    static inline support::Book* closed = nullptr;
    Q_INVOKABLE void CallFechoAno() {
        ++calls;
        closed->exec(u"delete from tbZelmar_Movimentos"_s);
    }
};

class YearEnd : public testing::Test {
protected:
    YearEnd() {
        forms::install();
        Closing::calls = 0;
        Closing::closed = &book;
        com::registerRunning(u"Zelmars.General"_s, [] { return new Closing; });
        if (support::onServer()) book.exec(u"grant vazio_gestor to %1"_s.arg(book.user()));
        const qint64 debtor = book.member({.no_kor = u"100015"_s});
        const qint64 creditor = book.member({.no_kor = u"100023"_s});
        post(1, debtor, 0, 12.5);
        post(2, creditor, 20, 0);
        post(3, creditor, 0, 20.05);
        post(3, 999, 0, 0);
        book.exec(u"update tbContadores set zelmars = 4"_s);
    }
    ~YearEnd() override {
        com::registerRunning(u"Zelmars.General"_s, {});
        if (support::onServer()) book.exec(u"revoke vazio_gestor from %1"_s.arg(book.user()));
    }
    void post(int number, qint64 socio, double credito, double debito) {
        book.insert(u"tbZelmar_Movimentos"_s, {{"movimento_no", number},
                                               {"socio_id", socio},
                                               {"data", QDate(2026, 11, 20)},
                                               {"tipo", u"REP"_s},
                                               {"credito", credito},
                                               {"debito", debito}});
        book.insert(u"tbSocios_Acumulados"_s,
                    {{"socio_id", socio}, {"credito_ac", credito}, {"debito_ac", debito}});
    }
    /// Chooses an entry of the menu; how many movements the list shows then.
    int choose(const QString& entry) {
        host::frmPrincipal window;
        window.show();
        window.findChild<QAction*>(entry)->trigger();
        const auto* count = window.findChild<QLabel*>(u"Contagem"_s);
        person.waitUntil([&] { return !count->text().contains(u"a ler"_s); },
                         u"the list is read"_s);
        return window.findChild<QTableView*>(u"Lista"_s)->model()->rowCount();
    }
    QString shown(const QString& box) { return person.peek<forms::TextBox>(box)->text(); }

    support::Book book;
    support::Operator person;
};

}  // namespace

TEST_F(YearEnd, IsPreparedByALookAndABackup) {
    const QString file = book.folder() + u"/antes.copia"_s;
    // Another program has the book open; on a server the test's own connection is one.
    QProcess other;
    if (!support::onServer()) {
        other.start(u"python3"_s, {u"-c"_s,
                                   u"import sqlite3, sys\n"
                                   "book = sqlite3.connect(sys.argv[1])\n"
                                   "book.execute('select count(*) from tbSocios').fetchone()\n"
                                   "print('open', flush=True)\n"
                                   "sys.stdin.read()"_s,
                                   book.folder() + u'/' + book.catalogue() + u".db"_s});
        ASSERT_TRUE(other.waitForReadyRead());
    }
    person.onScreen(u"frmPrepararFecho"_s, [&] {
        EXPECT_EQ(shown(u"Text1"_s), u"4 movimentos"_s);
        EXPECT_EQ(shown(u"Text2"_s), u"1 associados, € 12,50"_s);
        EXPECT_EQ(shown(u"Text3"_s), u"1 associados, € 0,05"_s);
        EXPECT_EQ(shown(u"Text4"_s), u"2 erros"_s);
        EXPECT_NE(shown(u"Text5"_s), u"ninguém"_s);
        person.put(u"Text6"_s, file);
        person.expectBox({.text = u"O livro está aberto também por"_s, .partly = true});
        person.accelerator(u'F');
        EXPECT_FALSE(QFile::exists(file));
        person.press(Qt::Key_Space);  // the focus is on what has to be ticked
        person.accelerator(u'F');
    });
    EXPECT_EQ(choose(u"CallFechoAno"_s), 0);
    EXPECT_TRUE(QFile::exists(file));
    EXPECT_EQ(Closing::calls, 1);
    other.kill();
    other.waitForFinished();
}

TEST_F(YearEnd, GoesNoFurtherWithoutItsBackup) {
    const QString file = book.folder() + u"/antes.copia"_s;
    QFile taken(file);
    ASSERT_TRUE(taken.open(QIODevice::WriteOnly));
    person.onScreen(u"frmPrepararFecho"_s, [&] {
        if (support::onServer()) {
            person.find(u"Check1"_s)->setFocus();
            person.press(Qt::Key_Space);
        }
        person.put(u"Text6"_s, u"antes.copia"_s);
        person.expectBox({.text = u"Indique o caminho inteiro"_s, .partly = true});
        person.accelerator(u'F');
        person.put(u"Text6"_s, file);
        person.expectBox({.text = u"Já existe o ficheiro"_s, .partly = true});
        person.accelerator(u'F');
        person.escape();
    });
    EXPECT_EQ(choose(u"CallFechoAno"_s), 4);
    EXPECT_EQ(taken.size(), 0);
    EXPECT_EQ(Closing::calls, 0);
}

TEST_F(YearEnd, ACheckNamesWhatIsWrong) {
    person.onScreen(u"frmVerificacao"_s, [&] {
        const QString text = person.find<QPlainTextEdit>(u"Text1"_s)->toPlainText();
        EXPECT_TRUE(text.contains(u"o associado 999 não existe"_s)) << text.toStdString();
        EXPECT_TRUE(text.contains(u"o número repete-se"_s));
        EXPECT_TRUE(text.contains(u"Foram encontrados 2 erros."_s));
        person.accelerator(u'S');
    });
    choose(u"Verificar"_s);
}

#include "YearEndTest.moc"
