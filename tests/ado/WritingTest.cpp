// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>
#include <sys/resource.h>

#include <csignal>

#include "SmallBook.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

const QString Movements = u"select * from tbMov"_s;

void add(const ado::RecordsetPtr& rows, const QString& nome) {
    rows->AddNew();
    rows->setCollect(u"nome"_s, nome);
    rows->Update();
}

}  // namespace

TEST(NewRows, TakeTheTablesDefaultsAndGiveTheirKeyBack) {
    SmallBook book;
    const auto rows = openRows(u"select * from tbMov where id = 0"_s, book.connect());
    EXPECT_TRUE(rows->atEnd());
    rows->AddNew();
    EXPECT_TRUE(rows->isNewRow());
    EXPECT_FALSE(rows->Collect(u"estado"_s).isValid());
    rows->setCollect(u"Nome"_s, u"Ana"_s);
    rows->Update();
    EXPECT_FALSE(rows->isNewRow());
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(1));
    EXPECT_EQ(rows->Collect(u"estado"_s), u"novo"_s);
    EXPECT_EQ(rows->RecordCount(), 1);
    EXPECT_EQ(rows->valueAt(0, 6), u"Ana"_s);
}

TEST(NewRows, CanBeDroppedAndLeaveNothing) {
    SmallBook book;
    book.exec(u"INSERT INTO tbMov(nome) VALUES('um')"_s);
    const auto rows = openRows(Movements, book.connect());
    rows->AddNew();
    rows->setCollect(u"nome"_s, u"x"_s);
    rows->CancelUpdate();
    EXPECT_EQ(rows->Collect(u"nome"_s), u"um"_s);
    rows->AddNew();
    rows->MoveFirst();
    EXPECT_FALSE(rows->isNewRow());
    rows->AddNew();
    rows->Close();
    EXPECT_EQ(book.value(u"SELECT count(*) FROM tbMov"_s), u"1"_s);
}

TEST(NewRows, SurviveClosingAndReopeningTheConnection) {
    SmallBook book;
    const auto connection = book.connect();
    const auto rows = openRows(u"select * from tbMov where id = 0"_s, connection);
    rows->AddNew();
    rows->setCollect(u"nome"_s, u"pendente"_s);
    connection->Close();
    EXPECT_EQ(rows->Collect(u"nome"_s), u"pendente"_s);
    rows->setCollect(u"valor"_s, 2);
    EXPECT_EQ(failureNumberOf([&] { rows->Update(); }), core::ObjectClosed);
    connection->Open();
    rows->Update();
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(1));
    EXPECT_EQ(book.value(u"SELECT nome || valor FROM tbMov"_s), u"pendente2"_s);
}

TEST(Rows, AreNotWrittenToAnotherBook) {
    SmallBook book;
    SmallBook other;
    book.exec(u"INSERT INTO tbMov(nome) VALUES('um')"_s);
    other.exec(u"INSERT INTO tbMov(nome) VALUES('alheio')"_s);
    const auto connection = book.connect();
    const auto rows = openRows(Movements, connection, ado::adOpenStatic, ado::adLockOptimistic);
    rows->setCollect(u"nome"_s, u"dois"_s);
    connection->Close();
    connection->ConnectionString = other.connect()->ConnectionString;
    connection->Open();
    EXPECT_EQ(failureNumberOf([&] { rows->Update(); }), core::NotUpdatable);
    EXPECT_EQ(other.value(u"SELECT nome FROM tbMov"_s), u"alheio"_s);
}

TEST(OptimisticUpdates, WriteTheChangedColumnsOnly) {
    SmallBook book;
    book.exec(u"INSERT INTO tbMov(nome, obs, valor) VALUES('um', 'velha', 1)"_s);
    const auto rows = openRows(Movements, book.connect(), ado::adOpenStatic, ado::adLockOptimistic);
    rows->setCollect(u"nome"_s, u"um"_s);  // the same again is no change
    rows->setCollect(u"valor"_s, 2.5);
    book.exec(u"UPDATE tbMov SET nome='alterado', obs='nova'"_s);
    rows->Update();
    EXPECT_EQ(book.value(u"SELECT nome || obs || valor FROM tbMov"_s), u"alteradonova2.5"_s);
    EXPECT_EQ(core::toText(rows->Collect(u"valor"_s)), u"2.5"_s);
    rows->Update();  // nothing to write
    rows->setCollect(u"valor"_s, 3);
    rows->CancelUpdate();
    EXPECT_EQ(core::toText(rows->Collect(u"valor"_s)), u"2.5"_s);
}

TEST(Updates, OfOneOfTwoEqualRowsTouchExactlyThatOne) {
    SmallBook book;
    book.exec(u"INSERT INTO tbSoma VALUES(1, 10, 1), (1, 10, 1), (1, 10, 1)"_s);
    const auto rows = openRows(u"select * from tbSoma where socio=1"_s, book.connect());
    rows->MoveNext();
    rows->setCollect(u"credito"_s, 20);
    rows->Update();
    EXPECT_EQ(book.value(u"SELECT group_concat(credito) FROM tbSoma"_s), u"10.0,20.0,10.0"_s);
    rows->MoveNext();
    rows->Delete();
    EXPECT_EQ(book.value(u"SELECT group_concat(credito) FROM tbSoma"_s), u"10.0,20.0"_s);
}

TEST(Updates, OfARowThatVanishedFailAndKeepWhatWasTyped) {
    SmallBook book;
    book.exec(u"INSERT INTO tbMov(nome) VALUES('um')"_s);
    const auto rows = openRows(Movements, book.connect(), ado::adOpenStatic, ado::adLockOptimistic);
    rows->setCollect(u"nome"_s, u"dois"_s);
    book.exec(u"DELETE FROM tbMov"_s);
    EXPECT_TRUE(failureOf([&] { rows->Update(); }).contains(u"apagada"_s));
    EXPECT_EQ(rows->Collect(u"nome"_s), u"dois"_s);
}

TEST(Updates, AreRefusedWhereRowsHaveNoTable) {
    SmallBook book;
    book.exec(u"INSERT INTO tbMov(nome) VALUES('um')"_s);
    const auto connection = book.connect();
    const auto view =
        openRows(u"SELECT * FROM vwMov"_s, connection, ado::adOpenDynamic, ado::adLockOptimistic);
    view->setCollect(u"nome"_s, u"por cima"_s);  // typed over, and it goes nowhere
    EXPECT_EQ(view->Collect(u"nome"_s), u"por cima"_s);
    EXPECT_EQ(failureNumberOf([&] { view->Update(); }), core::NotUpdatable);
    const auto reading =
        openRows(Movements, connection, ado::adOpenUnspecified, ado::adLockUnspecified);
    EXPECT_EQ(failureNumberOf([&] { reading->setCollect(u"nome"_s, u"x"_s); }), core::NotUpdatable);
    EXPECT_EQ(failureNumberOf([&] { reading->AddNew(); }), core::NotUpdatable);
    EXPECT_EQ(failureNumberOf([&] { reading->Delete(); }), core::NotUpdatable);
    EXPECT_EQ(book.value(u"SELECT nome FROM tbMov"_s), u"um"_s);
}

TEST(Updates, WhilePassingALongSetWriteEveryRowOnce) {
    SmallBook book;
    book.exec(
        u"INSERT INTO tbMov(socio, valor) WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i+1 "
        u"FROM n WHERE i < 300) SELECT i, NULL FROM n"_s);
    const auto rows = openRows(Movements, book.connect(), ado::adOpenStatic, ado::adLockOptimistic);
    rows->MoveLast();
    rows->MoveFirst();
    for (; !rows->atEnd(); rows->MoveNext()) {
        rows->setCollect(u"valor"_s, 0);
        rows->setCollect(u"socio"_s, rows->Collect(u"socio"_s).toInt() + 1000);
        rows->Update();
        ASSERT_EQ(core::toText(rows->Collect(u"valor"_s)), u"0"_s);
    }
    EXPECT_EQ(book.value(u"SELECT count(*) || '/' || sum(socio) || '/' || sum(valor) FROM tbMov"_s),
              u"300/345150/0"_s);
}

TEST(Deletes, EmptyATableRowByRow) {
    for (const int count : {5, 100}) {
        SmallBook book;
        book.exec(
            u"INSERT INTO tbSoma(socio) WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i+1 "
            u"FROM n WHERE i < %1) SELECT i FROM n"_s.arg(count));
        const auto rows = openRows(u"select * from tbSoma"_s, book.connect(), ado::adOpenStatic,
                                   ado::adLockOptimistic);
        while (!rows->atEnd()) {
            rows->Delete();
            EXPECT_EQ(failureNumberOf([&] { rows->Collect(u"socio"_s); }), core::NoCurrentRow);
            rows->MoveNext();
        }
        EXPECT_EQ(rows->RecordCount(), 0);
        EXPECT_EQ(book.value(u"SELECT count(*) FROM tbSoma"_s), u"0"_s);
    }
}

TEST(Deletes, DisappearFromLists) {
    SmallBook book;
    book.exec(u"INSERT INTO tbMov(nome) VALUES('a'), ('b'), ('c')"_s);
    const auto rows = openRows(Movements, book.connect());
    rows->MoveNext();
    rows->Delete();
    add(rows, u"d"_s);
    ASSERT_EQ(rows->rowsInMemory(), 3);
    QString names;
    for (int row = 0; row < 3; ++row) names += rows->valueAt(row, 6).toString();
    EXPECT_EQ(names, u"acd"_s);
    rows->MoveTo(1);
    EXPECT_EQ(rows->Collect(u"nome"_s), u"c"_s);
    rows->MoveNext();
    EXPECT_EQ(rows->Collect(u"nome"_s), u"d"_s);
    rows->MoveNext();
    EXPECT_TRUE(rows->atEnd());
}

TEST(FailingWrites, OnALockedBookBringTheEnginesText) {
    SmallBook book;
    const auto rows = openRows(Movements, book.connect(u"SQLOLEDB.1"_s, 0));
    book.exec(u"BEGIN IMMEDIATE"_s);
    EXPECT_EQ(failureOf([&] { add(rows, u"x"_s); }), u"database is locked"_s);
    EXPECT_TRUE(rows->isNewRow());
    book.exec(u"COMMIT"_s);
    rows->Update();
    EXPECT_EQ(book.value(u"SELECT nome FROM tbMov"_s), u"x"_s);
}

TEST(FailingWrites, OnAFullDiskBringTheEnginesTextAndChangeNothing) {
    SmallBook book;
    const auto rows = openRows(Movements, book.connect());
    add(rows, u"antes"_s);
    std::signal(SIGXFSZ, SIG_IGN);
    rlimit before{};
    getrlimit(RLIMIT_FSIZE, &before);
    const rlimit none{0, before.rlim_max};
    setrlimit(RLIMIT_FSIZE, &none);
    const QString text = failureOf([&] { add(rows, u"depois"_s); });
    setrlimit(RLIMIT_FSIZE, &before);
    EXPECT_EQ(text, u"disk I/O error"_s);
    EXPECT_EQ(book.value(u"SELECT group_concat(nome) FROM tbMov"_s), u"antes"_s);
    rows->Update();
    EXPECT_EQ(book.value(u"SELECT group_concat(nome) FROM tbMov"_s), u"antes,depois"_s);
}

TEST(FailingWrites, OnAConstraintBringTheEnginesText) {
    SmallBook book;
    book.exec(u"CREATE TABLE tbUnico (code VARCHAR(3) PRIMARY KEY NOT NULL)"_s);
    const auto rows = openRows(u"select * from tbUnico"_s, book.connect());
    rows->AddNew();
    EXPECT_EQ(failureOf([&] { rows->Update(); }), u"NOT NULL constraint failed: tbUnico.code"_s);
}
