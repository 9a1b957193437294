// SPDX-License-Identifier: MIT
#include "ServerBook.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

class Writing : public ServerBook {};

}  // namespace

TEST_F(Writing, ANewRowTakesDefaultsAndGivesItsKeyBack) {
    const auto rows = open(u"select * from tbMov where id = 0"_s, connection);
    rows->AddNew();
    EXPECT_FALSE(rows->Collect(u"estado"_s).isValid());
    rows->setCollect(u"Nome"_s, u"Ana"_s);
    rows->Update();
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(1));
    EXPECT_EQ(rows->Collect(u"estado"_s), u"novo"_s);
    EXPECT_EQ(rows->RecordCount(), 1);
    const auto empty = open(u"select * from tbSoma"_s, connection);
    empty->AddNew();
    empty->Update();
    EXPECT_EQ(exec(u"SELECT count(*) FROM tbSoma"_s), u"1"_s);
}

TEST_F(Writing, APendingRowSurvivesClosingAndReopening) {
    const auto rows = open(u"select * from tbMov where id = 0"_s, connection);
    rows->AddNew();
    rows->setCollect(u"nome"_s, u"pendente"_s);
    connection->Close();
    EXPECT_EQ(failureOf([&] { rows->Update(); }).number(), core::ObjectClosed);
    connection->Open();
    rows->Update();
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(1));
    EXPECT_EQ(exec(u"SELECT nome FROM tbMov"_s), u"pendente"_s);
}

TEST_F(Writing, TouchesExactlyOneOfSeveralEqualRows) {
    exec(u"INSERT INTO tbSoma VALUES(1, 10, 1), (1, 10, 1), (1, 10, 1)"_s);
    const QString credits = u"SELECT string_agg(credito::text, ',' ORDER BY _linha) FROM tbSoma"_s;
    const auto rows = open(u"select * from tbSoma where socio=1"_s, connection);
    rows->MoveNext();
    rows->setCollect(u"credito"_s, 20);
    rows->Update();
    EXPECT_EQ(exec(credits), u"10,20,10"_s);
    rows->MoveNext();
    rows->Delete();
    EXPECT_EQ(exec(credits), u"10,20"_s);
}

TEST_F(Writing, WithoutALockOverwritesTheChangedColumnsOnly) {
    exec(u"INSERT INTO tbMov(nome, obs, valor) VALUES('um', 'velha', 1)"_s);
    const auto rows = open(u"select * from tbMov"_s, connection, ado::adLockOptimistic);
    rows->setCollect(u"valor"_s, 2.5);
    exec(u"UPDATE tbMov SET nome='outro', obs='nova'"_s);
    rows->Update();
    EXPECT_EQ(exec(u"SELECT nome || obs || valor FROM tbMov"_s), u"outronova2.5000"_s);
    rows->setCollect(u"valor"_s, 3);
    exec(u"DELETE FROM tbMov"_s);
    EXPECT_TRUE(failureOf([&] { rows->Update(); }).text().contains(u"apagada"_s));
    EXPECT_EQ(core::toText(rows->Collect(u"valor"_s)), u"3"_s);
}

TEST_F(Writing, WhilePassingALongSetReachesEveryRowOnce) {
    fill(3000);
    const auto rows = open(u"select * from tbMov"_s, connection, ado::adLockOptimistic);
    for (; !rows->atEnd(); rows->MoveNext()) {
        rows->setCollect(u"socio"_s, rows->Collect(u"id"_s).toInt() + 10000);
        rows->Update();
    }
    EXPECT_EQ(exec(u"SELECT count(*) FROM tbMov WHERE socio = id + 10000"_s), u"3000"_s);
    rows->MoveFirst();
    for (; !rows->atEnd(); rows->MoveNext()) rows->Delete();
    EXPECT_EQ(exec(u"SELECT count(*) FROM tbMov"_s), u"0"_s);
}

TEST_F(Writing, ThatFailsBringsTheServersTextAndKeepsWhatWasTyped) {
    exec(
        u"CREATE TABLE tbUnico (code varchar(3) PRIMARY KEY, _linha bigint GENERATED ALWAYS AS "
        u"IDENTITY UNIQUE); INSERT INTO tbUnico VALUES('a')"_s);
    const auto rows = open(u"select * from tbUnico"_s, connection);
    rows->AddNew();
    rows->setCollect(u"code"_s, u"a"_s);
    const core::Failure failure = failureOf([&] { rows->Update(); });
    EXPECT_EQ(failure.number(), core::DatabaseFailure);
    EXPECT_EQ(failure.code(), u"23505"_s);
    EXPECT_EQ(failure.text(),
              u"duplicate key value violates unique constraint \"tbunico_pkey\"\n"
              u"Key (code)=(a) already exists."_s);
    EXPECT_TRUE(rows->isNewRow());
    rows->setCollect(u"code"_s, u"b"_s);
    rows->Update();
    EXPECT_EQ(exec(u"SELECT count(*) FROM tbUnico"_s), u"2"_s);
}

TEST_F(Writing, IsRefusedForViewsAndReadOnlySets) {
    fill(1);
    const auto view = open(u"SELECT * FROM vwMov"_s, connection, ado::adLockOptimistic);
    view->setCollect(u"nome"_s, u"por cima"_s);
    EXPECT_EQ(failureOf([&] { view->Update(); }).number(), core::NotUpdatable);
    const auto reading = open(u"SELECT * FROM tbMov"_s, connection, ado::adLockReadOnly);
    EXPECT_EQ(failureOf([&] { reading->AddNew(); }).number(), core::NotUpdatable);
}

TEST_F(Writing, ThatAnotherProgramHoldsUpGivesUpInTime) {
    fill(1);
    const auto rows = open(u"select * from tbMov"_s, connect(1), ado::adLockOptimistic);
    rows->setCollect(u"nome"_s, u"novo"_s);
    exec(u"BEGIN; UPDATE tbMov SET nome='preso'"_s);
    EXPECT_EQ(failureOf([&] { rows->Update(); }).code(), u"55P03"_s);
    exec(u"ROLLBACK"_s);
    rows->Update();
    EXPECT_EQ(exec(u"SELECT nome FROM tbMov"_s), u"novo"_s);
}
