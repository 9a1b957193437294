// SPDX-License-Identifier: MIT
#include <sqlite3.h>

#include <QDir>
#include <QElapsedTimer>
#include <QFile>

#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

class Connections : public SmallBook {};

TEST_F(Connections, SayWhatWasTriedAndMakeNothing) {
    const QTemporaryDir folder;
    const QString path = folder.path();
    QFile noBook(folder.filePath(u"texto.db"_s));
    ASSERT_TRUE(noBook.open(QIODevice::WriteOnly));
    noBook.write(QByteArray(5000, 'x'));
    noBook.close();
    QFile empty(folder.filePath(u"vazio.db"_s));
    ASSERT_TRUE(empty.open(QIODevice::WriteOnly));
    empty.close();
    QFile cut(folder.filePath(u"cortado.db"_s));
    ASSERT_TRUE(cut.open(QIODevice::WriteOnly));
    cut.write("SQLite format 3\0\x10\0\x02\x02\0\x40\x20\x20", 24);
    cut.write(QByteArray(400, '\1'));
    cut.close();
    const struct {
        QString source;
        QString catalogue;
        QString told;
    } rows[] = {
        {u"sqlite:"_s + path, u"nada"_s,
         u"Não foi possível abrir o livro «%1/nada.db». O ficheiro do livro não existe"_s.arg(
             path)},
        {u"sqlite:"_s + path, u"nada"_s, u"\n\nPormenores: unable to open database file"_s},
        {u"sqlite:"_s + path + u"/nada"_s, u"livro"_s, path + u"/nada/livro.db"_s},
        {u"SQLite:"_s + path, u"texto"_s, u"O ficheiro não é um livro, ou está estragado"_s},
        {u"SQLite:"_s + path, u"texto"_s, u"Pormenores: file is not a database"_s},
        {u"sqlite:"_s + path, u"vazio"_s, u"O ficheiro está vazio"_s},
        {u"sqlite:"_s + path, u"cortado"_s, u"O livro está estragado. Feche o programa"_s},
        {u"sqlite:"_s + path, {}, u"Initial Catalog"_s},
        {u"oracle:x"_s, u"livro"_s, u"«sqlite:PASTA» e «postgresql:SERVIDOR"_s},
        {{}, u"livro"_s, u"sqlite:PASTA"_s},
    };
    for (const auto& row : rows) {
        ado::Connection made;
        made.ConnectionString =
            u"INITIAL CATALOG=%2; data source = %1"_s.arg(row.source, row.catalogue);
        const QString text = failureOf([&] { made.Open(); }).text();
        EXPECT_TRUE(text.contains(row.told)) << qPrintable(text);
        EXPECT_EQ(made.State(), ado::adStateClosed);
    }
    EXPECT_EQ(QDir(path).entryList(QDir::AllEntries | QDir::NoDotAndDotDot),
              (QStringList{u"cortado.db"_s, u"texto.db"_s, u"vazio.db"_s}));
}

TEST_F(Connections, DoNotWaitForSomebodyWhoReadsABookWithAnotherJournal) {
    const QTemporaryDir folder;
    sqlite3* other = nullptr;
    sqlite3_open(QFile::encodeName(folder.filePath(u"lido.db"_s)).constData(), &other);
    sqlite3_exec(other, "CREATE TABLE a(b); INSERT INTO a VALUES(1); BEGIN; SELECT * FROM a",
                 nullptr, nullptr, nullptr);
    const auto reading = std::make_shared<ado::Connection>();
    reading->ConnectionString = u"Initial Catalog=lido;Data Source=sqlite:%1"_s.arg(folder.path());
    QElapsedTimer taken;
    taken.start();
    reading->Open();
    EXPECT_EQ(open(u"select * from a"_s, reading)->value(0), QVariant(1));
    EXPECT_LT(taken.elapsed(), 5000);
    sqlite3_close(other);
}

}  // namespace
