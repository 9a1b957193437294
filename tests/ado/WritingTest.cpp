// SPDX-License-Identifier: MIT
#include "SmallBook.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

const QString Movements = u"select * from tbMov"_s;

class Writing : public SmallBook {
protected:
    ado::RecordsetPtr optimistic() { return open(Movements, connection, ado::adLockOptimistic); }
    static void add(const ado::RecordsetPtr& rows, const QString& nome) {
        rows->AddNew();
        rows->setCollect(u"nome"_s, nome);
        rows->Update();
    }
    QString names() { return book.text(u"SELECT group_concat(nome) FROM tbMov"_s); }
};

TEST_F(Writing, ANewRowTakesTheTablesDefaultsAndGivesItsKeyBack) {
    const auto rows = open(u"select * from tbMov where id = 0"_s, connection);
    rows->AddNew();
    EXPECT_FALSE(rows->Collect(u"estado"_s).isValid());
    rows->setCollect(u"Nome"_s, u"Ana"_s);
    rows->Update();
    EXPECT_FALSE(rows->isNewRow());
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(1));
    EXPECT_EQ(rows->Collect(u"estado"_s), u"novo"_s);
    EXPECT_EQ(rows->RecordCount(), 1);
    EXPECT_EQ(rows->valueAt(0, 6), u"Ana"_s);
}

TEST_F(Writing, APendingRowSurvivesClosingAndReopeningTheConnection) {
    const auto rows = open(u"select * from tbMov where id = 0"_s, connection);
    rows->AddNew();
    rows->setCollect(u"nome"_s, u"pendente"_s);
    connection->Close();
    EXPECT_EQ(rows->Collect(u"nome"_s), u"pendente"_s);
    rows->setCollect(u"valor"_s, 2);
    EXPECT_EQ(failureOf([&] { rows->Update(); }).number(), core::ObjectClosed);
    connection->Open();
    rows->Update();
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(1));
    EXPECT_EQ(book.text(u"SELECT nome, valor FROM tbMov"_s), u"pendente|2"_s);
}

TEST_F(Writing, AnOptimisticUpdateTakesTheChangedColumnsOnly) {
    book.exec(u"INSERT INTO tbMov(nome, obs, valor) VALUES('um', 'velha', 1)"_s);
    const auto rows = optimistic();
    rows->setCollect(u"nome"_s, u"um"_s);  // the same again is no change
    rows->setCollect(u"valor"_s, 2.5);
    book.exec(u"UPDATE tbMov SET nome='alterado', obs='nova'"_s);
    rows->Update();
    EXPECT_EQ(book.text(u"SELECT nome, obs, valor FROM tbMov"_s), u"alterado|nova|2.5"_s);
    rows->setCollect(u"valor"_s, 3);
    rows->CancelUpdate();
    EXPECT_EQ(core::toText(rows->Collect(u"valor"_s)), u"2.5"_s);
}

TEST_F(Writing, OfSeveralEqualRowsExactlyTheCurrentOneChanges) {
    const QString sums = u"SELECT group_concat(credito) FROM tbSoma"_s;
    book.exec(u"INSERT INTO tbSoma VALUES(1, 10, 1), (1, 10, 1), (1, 10, 1)"_s);
    const auto rows = open(u"select * from tbSoma where socio=1"_s, connection);
    rows->MoveNext();
    rows->setCollect(u"credito"_s, 20);
    rows->Update();
    EXPECT_EQ(book.text(sums), u"10.0,20.0,10.0"_s);
    rows->MoveNext();
    rows->Delete();
    EXPECT_EQ(book.text(sums), u"10.0,20.0"_s);
}

TEST_F(Writing, ARowThatVanishedFailsAndKeepsWhatWasTyped) {
    book.exec(u"INSERT INTO tbMov(nome) VALUES('um')"_s);
    const auto rows = optimistic();
    rows->setCollect(u"nome"_s, u"dois"_s);
    book.exec(u"DELETE FROM tbMov"_s);
    EXPECT_TRUE(failureOf([&] { rows->Update(); }).text().contains(u"apagada"_s));
    EXPECT_EQ(rows->Collect(u"nome"_s), u"dois"_s);
}

TEST_F(Writing, WhilePassingALongSetTouchesEveryRowOnce) {
    fill(300);
    book.exec(u"UPDATE tbMov SET socio = id, valor = NULL"_s);
    const auto rows = optimistic();
    rows->MoveLast();
    rows->MoveFirst();
    for (; !rows->atEnd(); rows->MoveNext()) {
        rows->setCollect(u"valor"_s, 0);
        rows->setCollect(u"socio"_s, rows->Collect(u"socio"_s).toInt() + 1000);
        rows->Update();
        ASSERT_EQ(core::toText(rows->Collect(u"valor"_s)), u"0"_s);
    }
    EXPECT_EQ(book.text(u"SELECT count(*), sum(socio), sum(valor) FROM tbMov"_s),
              u"300|345150|0"_s);
}

TEST_F(Writing, OnALockedBookBringsTheEnginesText) {
    const auto rows = open(Movements, connect(0));
    book.exec(u"BEGIN IMMEDIATE"_s);
    EXPECT_EQ(failureOf([&] { add(rows, u"x"_s); }).text(), u"database is locked"_s);
    EXPECT_TRUE(rows->isNewRow());
    book.exec(u"COMMIT"_s);
    rows->Update();
    EXPECT_EQ(names(), u"x"_s);
}

}  // namespace
