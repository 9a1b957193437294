// SPDX-License-Identifier: MIT
#include <QDir>
#include <QFile>

#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

class Connections : public SmallBook {};

TEST_F(Connections, AndSetsFailReadablyInTheWrongState) {
    const auto rows = open(u"select 1 as um"_s, connection);
    EXPECT_EQ(failureOf([&] { rows->Open(u"select 1"_s, connection); }).number(), core::ObjectOpen);
    rows->Close();
    EXPECT_EQ(failureOf([&] { rows->MoveNext(); }).number(), core::ObjectClosed);
    EXPECT_EQ(failureOf([&] { rows->Collect(u"um"_s); }).number(), core::ObjectClosed);
    connection->Close();
    EXPECT_EQ(failureOf([&] { open(u"select 1"_s, connection); }).number(), core::ObjectClosed);
}

TEST_F(Connections, SayWhatWasTriedAndMakeNothing) {
    const QTemporaryDir folder;
    const QString path = folder.path();
    QFile noBook(folder.filePath(u"texto.db"_s));
    ASSERT_TRUE(noBook.open(QIODevice::WriteOnly));
    noBook.write(QByteArray(5000, 'x'));
    noBook.close();
    const struct {
        QString source;
        QString catalogue;
        QString told;
    } rows[] = {
        {u"sqlite:"_s + path, u"nada"_s,
         u"Não foi possível abrir o livro «%1/nada.db»: unable to open database file"_s.arg(path)},
        {u"sqlite:"_s + path + u"/nada"_s, u"livro"_s, path + u"/nada/livro.db"_s},
        {u"SQLite:"_s + path, u"texto"_s, u": file is not a database"_s},
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
              QStringList(u"texto.db"_s));
}

TEST_F(Connections, SeeTablesThatAreAlteredLater) {
    const QString text = u"select * from tbConta where proximo = 1"_s;
    EXPECT_EQ(open(text, connection)->columnCount(), 1);
    book.exec(
        u"ALTER TABLE tbConta ADD COLUMN nota VARCHAR(7); INSERT INTO tbConta VALUES(1, 'a')"_s);
    const auto rows = open(text, connection);
    EXPECT_EQ(rows->Collect(u"nota"_s), u"a"_s);
    EXPECT_EQ(rows->Fields(u"nota"_s).DefinedSize(), 7);
}

}  // namespace
