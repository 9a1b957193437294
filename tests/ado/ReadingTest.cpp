// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QFile>

#include "SmallBook.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

/// Rows 1 to `count` of tbMov.
void fill(SmallBook& book, int count) {
    book.exec(
        u"INSERT INTO tbMov(socio, tipo, nome, valor) WITH RECURSIVE n(i) AS (SELECT 1 UNION "
        u"ALL SELECT i + 1 FROM n WHERE i < %1) SELECT i % 7, 'DOC', 'n' || i, i * 0.01 FROM n"_s
            .arg(count));
}

QString all(const ado::RecordsetPtr& rows, const QString& column) {
    QStringList texts;
    for (; !rows->atEnd(); rows->MoveNext()) {
        const QVariant value = rows->Collect(column);
        texts += value.isValid() ? core::toText(value) : u"NULL"_s;
    }
    return texts.join(u',');
}

qint64 residentKilobytes() {
    QFile file(u"/proc/self/statm"_s);
    if (!file.open(QIODevice::ReadOnly)) return 0;
    return file.readAll().split(' ').value(1).toLongLong() * 4;
}

}  // namespace

TEST(Reading, KeepsNullEmptyAndZeroApart) {
    SmallBook book;
    book.exec(u"INSERT INTO tbMov(nome, valor) VALUES(NULL, NULL), ('', 0)"_s);
    const auto rows = openRows(u"select * from tbMov"_s, book.connect());
    EXPECT_FALSE(rows->Collect(u"nome"_s).isValid());
    EXPECT_FALSE(rows->Collect(u"valor"_s).isValid());
    rows->MoveNext();
    EXPECT_EQ(rows->Collect(u"nome"_s), QVariant(u""_s));
    EXPECT_EQ(core::toText(rows->Collect(u"valor"_s)), u"0"_s);
    rows->MoveNext();
    EXPECT_TRUE(rows->atEnd());
    EXPECT_EQ(failureNumberOf([&] { rows->Collect(u"nome"_s); }), core::NoCurrentRow);
}

TEST(Reading, GivesRowsInTheOrderOfInsertionAlsoAfterUpdates) {
    SmallBook book;
    book.exec(
        u"INSERT INTO tbMov(socio, tipo) VALUES(5,'REP'), (5,'DOC'), (5,'PAG'), (4,'HOS');"
        u"UPDATE tbMov SET tipo='AAA' WHERE id=3"_s);
    const auto connection = book.connect();
    EXPECT_EQ(all(openRows(u"select * from tbMov where socio > 3"_s, connection), u"id"_s),
              u"1,2,3,4"_s);
    EXPECT_EQ(all(openRows(u"select id, tipo from tbMov where socio=5"_s, connection), u"id"_s),
              u"1,2,3"_s);
}

TEST(Reading, SortsAsAPortugueseReaderExpects) {
    SmallBook book;
    book.exec(
        u"INSERT INTO tbHosp(nome) VALUES('Zita'), ('Évora'), (NULL), ('etc'), ('Eva'), "
        u"('água'), ('Ana'), ('eva')"_s);
    const auto connection = book.connect();
    EXPECT_EQ(all(openRows(u"select * from tbHosp order by nome;"_s, connection), u"nome"_s),
              u"NULL,água,Ana,etc,eva,Eva,Évora,Zita"_s);
    EXPECT_EQ(openRows(u"select * from tbHosp where nome='EVA'"_s, connection)->RecordCount(), 0);
}

TEST(Reading, KeepsDifferencesOfAmountsExact) {
    SmallBook book;
    book.exec(
        u"CREATE TABLE tbD (s INTEGER, debito MONEY, credito MONEY);"
        u"INSERT INTO tbD VALUES(1, 0.4, 0.3), (2, 0.40011, 0.3)"_s);
    const auto rows = openRows(
        u"SELECT s, SUM(debito) - SUM(credito) AS divida FROM tbD GROUP BY s "
        u"HAVING (((SUM(debito) - SUM(credito)) > 0.1))"_s,
        book.connect());
    EXPECT_EQ(all(rows, u"s"_s), u"2"_s);
}

TEST(Reading, OrdersAUnionOfGroupsByAColumnOfItsFirstPart) {
    SmallBook book;
    book.exec(
        u"INSERT INTO tbHosp VALUES(1,'a','Luz'), (2,'b','Évora'); CREATE TABLE tbVelho AS SELECT "
        u"* "
        u"FROM tbMov; INSERT INTO tbMov(socio, valor) VALUES(1, 5), (2, 6); INSERT INTO "
        u"tbVelho(socio, valor) VALUES(1, 7)"_s);
    const QString part =
        u"SELECT %1.socio, tbHosp.nome AS hospital FROM %1 LEFT JOIN tbHosp ON %1.socio = "
        u"tbHosp.hosp_id GROUP BY %1.socio, tbHosp.nome "_s;
    const auto rows = openRows(
        part.arg(u"tbMov"_s) + u"UNION "_s + part.arg(u"tbVelho"_s) + u"ORDER BY tbHosp.nome"_s,
        book.connect());
    EXPECT_EQ(rows->Fields(u"hospital"_s).DefinedSize(), 40);
    EXPECT_EQ(all(rows, u"hospital"_s), u"Évora,Luz"_s);
}

TEST(Reading, ReadsDatesOfStatementsAsMonthDayYear) {
    SmallBook book;
    book.exec(u"INSERT INTO tbMov(data) VALUES('2001-03-31 00:00:00'), ('2001-04-01 00:00:00')"_s);
    const auto rows = openRows(
        u"SELECT * FROM tbMov WHERE data <= CONVERT(DATETIME,'03/31/2001 00:00:00', 102)"_s,
        book.connect());
    EXPECT_EQ(rows->RecordCount(), 1);
    EXPECT_EQ(core::toDate(rows->Collect(u"data"_s)), QDate(2001, 3, 31));
}

TEST(Reading, JoinsTextsAndANullTakesAllOfThem) {
    SmallBook book;
    book.exec(u"INSERT INTO tbHosp(code, nome) VALUES('01','Luz'), (NULL,'Sol')"_s);
    const auto rows =
        openRows(u"SELECT tbHosp.*, code + ' - ' + nome AS completo FROM tbHosp"_s, book.connect());
    EXPECT_EQ(all(rows, u"COMPLETO"_s), u"01 - Luz,NULL"_s);
}

class SetOf : public testing::TestWithParam<int> {};

TEST_P(SetOf, RowsIsPassedCountedAndPassedAgain) {
    SmallBook book;
    fill(book, GetParam());
    const auto rows = openRows(u"select * from tbMov"_s, book.connect());
    rows->MoveLast();
    EXPECT_EQ(rows->RecordCount(), GetParam());
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(GetParam()));
    rows->MoveNext();
    EXPECT_TRUE(rows->atEnd());
    rows->MoveFirst();
    int expected = 0;
    for (; !rows->atEnd(); rows->MoveNext())
        ASSERT_EQ(rows->Collect(u"id"_s), QVariant(++expected));
    EXPECT_EQ(expected, GetParam());
    rows->MoveFirst();
    rows->MoveNext();
    EXPECT_EQ(rows->Collect(u"nome"_s), u"n2"_s);
}

INSTANTIATE_TEST_SUITE_P(Sizes, SetOf, testing::Values(2, 31, 32, 33, 34, 500));

TEST(StaticSets, DoNotSeeLaterWritesHoweverLongTheyAre) {
    for (const int count : {3, 400}) {
        SmallBook book;
        fill(book, count);
        const auto connection = book.connect();
        const auto rows = openRows(u"select * from tbMov"_s, connection, ado::adOpenStatic,
                                   ado::adLockOptimistic);
        book.exec(
            u"UPDATE tbMov SET nome='mudado'; INSERT INTO tbMov(nome) VALUES('novo');"
            u"DELETE FROM tbMov WHERE id=2"_s);
        rows->MoveLast();
        EXPECT_EQ(rows->RecordCount(), count);
        EXPECT_EQ(rows->Collect(u"nome"_s), u"n%1"_s.arg(count));
        rows->MoveFirst();
        rows->MoveNext();
        EXPECT_EQ(rows->Collect(u"nome"_s), u"n2"_s);
        // The open scan hides nothing from the other reads of the connection.
        EXPECT_EQ(openRows(u"select nome from tbMov where id=1"_s, connection)->value(0),
                  u"mudado"_s);
    }
}

TEST(DynamicSets, ReadEachRowAfreshAndPassTheGoneOnes) {
    SmallBook book;
    fill(book, 100);
    const auto rows = openRows(u"select * from tbMov"_s, book.connect(), ado::adOpenDynamic,
                               ado::adLockOptimistic);
    book.exec(
        u"UPDATE tbMov SET nome='mudado' WHERE id IN (2, 60); DELETE FROM tbMov WHERE id=3"_s);
    rows->MoveNext();
    EXPECT_EQ(rows->Collect(u"nome"_s), u"mudado"_s);
    rows->MoveNext();
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(4));
    while (rows->Collect(u"id"_s).toInt() < 60) rows->MoveNext();
    EXPECT_EQ(rows->Collect(u"nome"_s), u"mudado"_s);
}

TEST(LongSets, ArePassedInBoundedMemory) {
    SmallBook book;
    fill(book, 200000);  // some 8 MB of rows
    const auto connection = book.connect();
    const qint64 before = residentKilobytes();
    const auto rows = openRows(u"select * from tbMov"_s, connection);
    int count = 0;
    for (; !rows->atEnd(); rows->MoveNext()) ++count;
    EXPECT_EQ(count, 200000);
    EXPECT_LT(residentKilobytes() - before, 6000);
}

TEST(Lists, ShowRowsWithoutMovingAndJumpToOne) {
    SmallBook book;
    fill(book, 80);
    const auto rows = openRows(u"select * from tbMov"_s, book.connect());
    EXPECT_EQ(rows->rowsInMemory(), 0);
    EXPECT_EQ(failureNumberOf([&] { rows->valueAt(0, 0); }), core::NoCurrentRow);
    rows->MoveNext();
    rows->readAll();
    EXPECT_EQ(rows->rowsInMemory(), 80);
    EXPECT_EQ(rows->valueAt(79, 6), u"n80"_s);
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(2));
    rows->MoveTo(70);
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(71));
    EXPECT_EQ(failureNumberOf([&] { rows->MoveTo(80); }), core::NoCurrentRow);
}

// Statements that differ in the values of their conditions only share one prepared query.
TEST(RepeatedStatements, ReadWhatTheirOwnValuesSay) {
    SmallBook book;
    book.exec(
        u"INSERT INTO tbMov(socio, nome, valor) VALUES(5,'5',1.5), (6,'x''y',-2), (7,'5.0',3)"_s);
    const auto connection = book.connect();
    const auto ids = [&](const QString& condition) {
        return all(openRows(u"select * from tbMov where "_s + condition, connection), u"id"_s);
    };
    EXPECT_EQ(ids(u"socio = 5"_s), u"1"_s);
    EXPECT_EQ(ids(u"socio = 6"_s), u"2"_s);
    EXPECT_EQ(ids(u"socio = '6'"_s), u"2"_s);
    EXPECT_EQ(ids(u"nome = '5'"_s), u"1"_s);
    EXPECT_EQ(ids(u"nome = 5"_s), u"1"_s);
    EXPECT_EQ(ids(u"nome = 'x''y'"_s), u"2"_s);
    EXPECT_EQ(ids(u"valor = 1.5"_s), u"1"_s);
    EXPECT_EQ(ids(u"valor < -1"_s), u"2"_s);
    EXPECT_EQ(ids(u"socio = 1e0 * 7"_s), u"3"_s);
    EXPECT_EQ(ids(u"socio = 99999999999999999999"_s), QString());
    const auto first = openRows(u"select nome from tbMov where socio = 5"_s, connection);
    const auto second = openRows(u"select nome from tbMov where socio = 6"_s, connection);
    EXPECT_EQ(first->value(0), u"5"_s);
    EXPECT_EQ(second->value(0), u"x'y"_s);
}

TEST(RepeatedStatements, FollowATableThatIsAltered) {
    SmallBook book;
    const auto connection = book.connect();
    const QString text = u"select * from tbConta where proximo = 1"_s;
    EXPECT_EQ(openRows(text, connection)->columnCount(), 1);
    book.exec(
        u"ALTER TABLE tbConta ADD COLUMN nota VARCHAR(7); INSERT INTO tbConta VALUES(1, 'a')"_s);
    const auto rows = openRows(text, connection);
    EXPECT_EQ(rows->Collect(u"nota"_s), u"a"_s);
    EXPECT_EQ(rows->Fields(u"nota"_s).DefinedSize(), 7);
}

TEST(Recordsets, AreOpenOrClosed) {
    SmallBook book;
    const auto connection = book.connect();
    const auto rows = openRows(u"select 1 as um"_s, connection);
    EXPECT_EQ(failureNumberOf([&] { rows->Open(u"select 1"_s, connection); }), core::ObjectOpen);
    rows->Close();
    EXPECT_EQ(rows->State(), ado::adStateClosed);
    EXPECT_EQ(failureNumberOf([&] { rows->Close(); }), core::ObjectClosed);
    EXPECT_EQ(failureNumberOf([&] { rows->MoveNext(); }), core::ObjectClosed);
    EXPECT_EQ(failureNumberOf([&] { rows->Collect(u"um"_s); }), core::ObjectClosed);
    EXPECT_NE(failureOf([&] { rows->Open(u"select x"_s, connection); }), QString());
    EXPECT_EQ(rows->State(), ado::adStateClosed);
}
