// SPDX-License-Identifier: MIT
// What columns keep, in which order rows come, and which rows a set has.
#include <QDateTime>
#include <QFile>

#include "ServerBook.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

class Rows : public ServerBook {};

qint64 residentKilobytes() {
    QFile file(u"/proc/self/statm"_s);
    return file.open(QIODevice::ReadOnly) ? file.readAll().split(' ').value(1).toLongLong() * 4 : 0;
}

}  // namespace

TEST_F(Rows, KeepWhatTheirColumnsKeep) {
    const struct {
        const char* column;
        QVariant written;
        QVariant read;
        const char* stored;
    } cases[] = {
        {"valor", u"922337203685477.5807"_s, {}, "922337203685477.5807"},
        {"valor", 0.00005, {}, "0.0001"},
        {"valor", u"-0"_s, {}, "0.0000"},
        {"valor", QVariant(), {}, "NULL"},
        {"socio", 6.5, 6, "6"},
        {"pequeno", -32768, -32768, "-32768"},
        {"grande", QVariant(9007199254740993LL), QVariant(9007199254740993LL), "9007199254740993"},
        {"taxa", u"23.5"_s, 23.5, "23.5"},
        {"taxa", 0.1 + 0.2, 0.1 + 0.2, "0.30000000000000004"},
        {"data", u"12/31/1999"_s, QDateTime(QDate(1999, 12, 31), QTime(0, 0), Qt::UTC),
         "1999-12-31 00:00:00"},
        {"nome", u""_s, u""_s, ""},
        {"nome", u"O'Brien \\%"_s, u"O'Brien \\%"_s, "O'Brien \\%"},
        {"nome", u"çãéõ€😀🎉abc"_s, u"çãéõ€😀🎉abc"_s, "çãéõ€😀🎉abc"},
    };
    for (const auto& row : cases) {
        const QString column = QString::fromLatin1(row.column);
        const auto rows = open(u"select * from tbMov where id = 0"_s, connection);
        rows->AddNew();
        rows->setCollect(column, row.written);
        const QVariant before = rows->Collect(column);
        rows->Update();
        EXPECT_EQ(rows->Collect(column), before) << row.stored;
        if (row.read.isValid()) {
            EXPECT_EQ(before, row.read) << row.stored;
        }
        EXPECT_EQ(exec(u"SELECT %1 FROM tbMov ORDER BY id DESC LIMIT 1"_s.arg(column)),
                  QString::fromUtf8(row.stored));
    }
    const auto sums = open(u"select * from tbSoma"_s, connection);
    sums->AddNew();
    sums->setCollect(u"credito"_s, 33.33 * 0.7);
    sums->Update();
    EXPECT_EQ(sums->Collect(u"credito"_s), QVariant(static_cast<float>(33.33 * 0.7)));
}

TEST_F(Rows, TellTypesAndSizesAndHideTheServersIdentity) {
    const auto rows = open(u"select * from tbMov"_s, connection);
    EXPECT_EQ(rows->columnCount(), 11);
    EXPECT_EQ(rows->Fields(u"NOME"_s).DefinedSize(), 10);
    EXPECT_EQ(rows->Fields(u"obs"_s).DefinedSize(), 0);
    EXPECT_EQ(rows->Fields(u"valor"_s).Type(), ado::ColumnType::Money);
    EXPECT_EQ(rows->Fields(u"data"_s).Type(), ado::ColumnType::DateTime);
    for (const auto lock : {ado::adLockPessimistic, ado::adLockReadOnly})
        EXPECT_EQ(open(u"select * from tbSoma"_s, connection, lock)->columnCount(), 3);
    EXPECT_EQ(open(u"select sum(valor) as s from tbMov"_s, connection)->Fields(0).Type(),
              ado::ColumnType::Double);
}

TEST_F(Rows, ComeInTheOrderOfInsertionAlsoAfterUpdates) {
    exec(
        u"INSERT INTO tbMov(socio, tipo) VALUES(5,'REP'), (5,'DOC'), (5,'PAG'), (4,'HOS');"
        u"INSERT INTO tbSoma(socio) VALUES(3), (1), (2);"
        u"UPDATE tbMov SET tipo='AAA' WHERE id=1; UPDATE tbSoma SET docs=1 WHERE socio=3"_s);
    EXPECT_EQ(valuesOf(open(u"select * from tbMov where socio > 3"_s, connection), u"id"_s),
              u"1,2,3,4"_s);
    EXPECT_EQ(valuesOf(open(u"select socio from tbSoma"_s, connection), u"socio"_s), u"3,1,2"_s);
    EXPECT_EQ(valuesOf(open(u"select s.socio from ((tbSoma s left join tbMov on s.socio = id))"_s,
                            connection),
                       u"socio"_s),
              u"3,1,2"_s);
}

TEST_F(Rows, SortAsAPortugueseReaderExpectsWithNullsFirst) {
    exec(
        u"INSERT INTO tbMov(nome) VALUES('Zita'), ('Évora'), (NULL), ('etc'), ('Eva'), ('água'), "
        u"('Ana'), ('eva')"_s);
    const QString ordered = u"select nome, nome + ' x' as quem from tbMov order by "_s;
    EXPECT_EQ(valuesOf(open(ordered + u"nome;"_s, connection), u"nome"_s),
              u"NULL,água,Ana,etc,eva,Eva,Évora,Zita"_s);
    EXPECT_EQ(valuesOf(open(ordered + u"quem desc"_s, connection), u"nome"_s),
              u"Zita,Évora,Eva,eva,etc,Ana,água,NULL"_s);
    EXPECT_EQ(open(u"select * from tbMov where nome='EVA'"_s, connection)->RecordCount(), 0);
}

TEST_F(Rows, OfAStaticSetDoNotChangeHoweverManyTheyAre) {
    for (const int count : {3, 63, 64, 65, 2500}) {
        exec(u"TRUNCATE tbMov RESTART IDENTITY"_s);
        fill(count);
        const auto rows = open(u"select * from tbMov"_s, connection, ado::adLockOptimistic);
        exec(
            u"UPDATE tbMov SET nome='mudado'; INSERT INTO tbMov(nome) VALUES('novo');"
            u"DELETE FROM tbMov WHERE id=2"_s);
        rows->MoveLast();
        EXPECT_EQ(rows->RecordCount(), count);
        EXPECT_EQ(rows->Collect(u"nome"_s), u"n%1"_s.arg(count));
        rows->MoveFirst();
        int expected = 0;
        for (; !rows->atEnd(); rows->MoveNext())
            ASSERT_EQ(rows->Collect(u"nome"_s), u"n%1"_s.arg(++expected));
        EXPECT_EQ(expected, count);
        // The open scan hides nothing from the other reads of the connection.
        EXPECT_EQ(open(u"select nome from tbMov where id=1"_s, connection)->value(0), u"mudado"_s);
    }
}

TEST_F(Rows, OfALongSetArePassedInBoundedMemory) {
    fill(200000);  // some 8 MB of rows
    [[maybe_unused]] const qint64 before = residentKilobytes();
    const auto rows = open(u"select * from tbMov"_s, connection);
    int count = 0;
    for (; !rows->atEnd(); rows->MoveNext()) ++count;
    EXPECT_EQ(count, 200000);
#ifndef __SANITIZE_ADDRESS__
    // The sanitizer keeps what was freed for a while.
    EXPECT_LT(residentKilobytes() - before, 6000);
#endif
}
