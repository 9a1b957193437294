// SPDX-License-Identifier: MIT
#include <QDir>
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

}  // namespace
