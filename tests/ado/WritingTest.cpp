// SPDX-License-Identifier: MIT
#include "SmallBook.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

const QString Movements = u"select * from tbMov"_s;

class Writing : public SmallBook {
protected:
    ado::RecordsetPtr optimistic() { return open(Movements, connection, ado::adLockOptimistic); }
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
    const auto empty = open(u"select * from tbSoma"_s, connection);
    empty->AddNew();
    empty->Update();
    EXPECT_EQ(book.text(u"SELECT socio, credito FROM tbSoma"_s), u"NULL|NULL"_s);
}

// A note in another table: both writes stand, or neither.
TEST_F(Writing, WhatAccompaniesARowIsStoredWithItOrNothingIs) {
    using Kind = ado::Accompanying::Kind;
    const auto state = [this] {
        return book.text(
            u"SELECT (SELECT count(*) FROM tbMov), (SELECT max(nome) FROM tbMov), "
            "(SELECT count(*) FROM tbHosp), (SELECT max(nome) FROM tbHosp), "
            "(SELECT max(hosp_id) FROM tbHosp)"_s);
    };
    const auto note = [](const QString& code, const QString& nome) {
        return ado::Accompanying{
            Kind::Update,           u"tbHosp"_s,        {u"nome"_s}, {nome}, {},
            {u"code"_s, u"nome"_s}, {code, u"espera"_s}};
    };
    const auto rows = open(Movements, connection);
    rows->AddNew();
    rows->setCollect(u"nome"_s, u"um"_s);
    rows->Update(ado::Accompanying{
        Kind::Insert, u"tbHosp"_s, {u"code"_s, u"nome"_s}, {u"a"_s, u"espera"_s}, u"hosp_id"_s});
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(1));
    EXPECT_EQ(state(), u"1|um|1|espera|1"_s);

    rows->setCollect(u"nome"_s, u"dois"_s);
    EXPECT_EQ(failureOf([&] { rows->Update(note(u"b"_s, u"feito"_s)); }).number(),
              core::NotAccompanied);
    const ado::Accompanying none{Kind::Delete, u"tbHosp"_s, {}, {}, {}, {u"code"_s}, {u"b"_s}};
    EXPECT_EQ(failureOf([&] { rows->Update(none); }).number(), core::NotAccompanied);
    rows->AddNew();
    rows->setCollect(u"nome"_s, u"novo"_s);
    EXPECT_EQ(failureOf([&] { rows->Update(note(u"b"_s, u"feito"_s)); }).number(),
              core::NotAccompanied);
    EXPECT_EQ(state(), u"1|um|1|espera|1"_s);

    const auto again = open(Movements, connection);
    again->setCollect(u"nome"_s, u"dois"_s);
    again->Update(note(u"a"_s, u"feito"_s));
    EXPECT_EQ(state(), u"1|dois|1|feito|1"_s);
    // Also where the row itself has no change.
    book.exec(u"UPDATE tbHosp SET nome = 'espera'"_s);
    again->Update(ado::Accompanying{Kind::Delete, u"tbHosp"_s, {}, {}, {}, {u"code"_s}, {u"a"_s}});
    EXPECT_EQ(state(), u"1|dois|0|NULL|NULL"_s);
    // The row's own failure takes the note back.
    book.refuse(u"update on tbMov"_s, u"disco cheio"_s);
    again->setCollect(u"nome"_s, u"tres"_s);
    EXPECT_NE(
        failureOf([&] {
            again->Update(ado::Accompanying{Kind::Insert, u"tbHosp"_s, {u"code"_s}, {u"c"_s}});
        }).text(),
        QString());
    EXPECT_EQ(state(), u"1|dois|0|NULL|NULL"_s);
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
    rows->setCollect(u"valor"_s, 2.5);
    book.exec(u"UPDATE tbMov SET nome='alterado', obs='nova'"_s);
    rows->Update();
    EXPECT_EQ(book.text(u"SELECT nome, obs, valor FROM tbMov"_s), u"alterado|nova|2.5"_s);
    rows->setCollect(u"valor"_s, 3);
    rows->CancelUpdate();
    EXPECT_EQ(core::toText(rows->Collect(u"valor"_s)), u"2.5"_s);
}

// What the set shows may be older than what others stored, or than what it stored itself.
TEST_F(Writing, ThroughAnOptimisticSetStoresEveryAssignment) {
    fill(100);
    for (const int last : {20, 100}) {
        const auto rows = open(u"select * from tbMov where id <= %1"_s.arg(last), connection,
                               ado::adLockOptimistic);
        book.exec(u"UPDATE tbMov SET obs = 'outro posto'"_s);
        for (const QString& text : {u"um"_s, u"dois"_s, QString(), u"um"_s}) {
            rows->MoveLast();
            rows->MoveFirst();
            rows->setCollect(u"obs"_s, text.isNull() ? QVariant() : text);
            rows->Update();
            rows->MoveNext();
            rows->MoveFirst();
            EXPECT_EQ(rows->Collect(u"obs"_s).toString(), text) << last;
            rows->AddNew();
            rows->CancelUpdate();
            EXPECT_EQ(rows->Collect(u"obs"_s).toString(), text) << last;
            EXPECT_EQ(book.value(u"SELECT obs FROM tbMov WHERE id = 1"_s).toString(), text);
        }
        rows->readAll();
        EXPECT_EQ(rows->valueAt(0, 7), u"um"_s);
    }
}

TEST_F(Writing, OfSeveralEqualRowsExactlyTheCurrentOneChanges) {
    const auto credits = [&] {
        return valuesOf(open(u"select * from tbSoma"_s, connect(), ado::adLockReadOnly),
                        u"credito"_s);
    };
    book.exec(u"INSERT INTO tbSoma VALUES(1, 10, 1), (1, 10, 1), (1, 10, 1)"_s);
    const auto rows = open(u"select * from tbSoma where socio=1"_s, connection);
    rows->MoveNext();
    rows->setCollect(u"credito"_s, 20);
    rows->Update();
    EXPECT_EQ(credits(), u"10,20,10"_s);
    rows->MoveNext();
    rows->Delete();
    EXPECT_EQ(credits(), u"10,20"_s);
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
    fill(3000);
    book.exec(u"UPDATE tbMov SET socio = id, valor = NULL"_s);
    const auto rows = optimistic();
    rows->MoveLast();
    rows->MoveFirst();
    for (; !rows->atEnd(); rows->MoveNext()) {
        rows->setCollect(u"valor"_s, 0);
        rows->setCollect(u"socio"_s, rows->Collect(u"socio"_s).toInt() + 10000);
        rows->Update();
        ASSERT_EQ(core::toText(rows->Collect(u"valor"_s)), u"0"_s);
    }
    EXPECT_EQ(book.count(u"tbMov"_s, u"socio = id + 10000 AND valor = 0"_s), 3000);
    rows->MoveFirst();
    for (; !rows->atEnd(); rows->MoveNext()) rows->Delete();
    EXPECT_EQ(book.count(u"tbMov"_s), 0);
}

TEST_F(Writing, IsRefusedForViewsAndReadOnlySets) {
    fill(1);
    const auto view = open(u"SELECT * FROM vwMov"_s, connection, ado::adLockOptimistic);
    view->setCollect(u"nome"_s, u"por cima"_s);
    EXPECT_EQ(failureOf([&] { view->Update(); }).number(), core::NotUpdatable);
    const auto reading = open(Movements, connection, ado::adLockReadOnly);
    EXPECT_EQ(failureOf([&] { reading->AddNew(); }).number(), core::NotUpdatable);
}

TEST_F(Writing, ThatFailsBringsTheEnginesTextAndKeepsWhatWasTyped) {
    book.exec(u"INSERT INTO tbUnico VALUES('a')"_s);
    const auto rows = open(u"select * from tbUnico"_s, connection);
    rows->AddNew();
    rows->setCollect(u"code"_s, u"a"_s);
    const core::Failure failure = failureOf([&] { rows->Update(); });
    EXPECT_EQ(failure.number(), core::DatabaseFailure);
    EXPECT_EQ(failure.code(), support::onServer() ? u"23505"_s : u"1555"_s);
    EXPECT_EQ(failure.text(),
              u"Já existe um registo com este valor, que não se pode repetir; nada foi gravado."
              "\n\nPormenores: "_s +
                  (support::onServer()
                       ? u"duplicate key value violates unique constraint \"tbunico_pkey\"\n"
                         "Key (code)=(a) already exists."_s
                       : u"UNIQUE constraint failed: tbUnico.code"_s));
    EXPECT_TRUE(rows->isNewRow());
    rows->setCollect(u"code"_s, u"b"_s);
    rows->Update();
    EXPECT_EQ(book.count(u"tbUnico"_s), 2);
}

TEST_F(Writing, ThatBreaksARuleOfTheBookSaysWhich) {
    book.exec(u"CREATE TABLE tbRegra (a INTEGER NOT NULL, b INTEGER CHECK (b < 5)%1)"_s.arg(
        support::onServer() ? u", _linha bigint GENERATED ALWAYS AS IDENTITY UNIQUE"_s
                            : QString()));
    const auto rows = open(u"select * from tbRegra"_s, connection);
    const auto textOfAdding = [&](const QVariant& a, const QVariant& b) {
        rows->AddNew();
        rows->setCollect(u"a"_s, a);
        rows->setCollect(u"b"_s, b);
        const QString text = failureOf([&] { rows->Update(); }).text();
        rows->CancelUpdate();
        return text.section(u"; nada foi gravado.\n\nPormenores: "_s, 0, 0);
    };
    EXPECT_EQ(textOfAdding({}, 1), u"Falta preencher um valor obrigatório"_s);
    EXPECT_EQ(textOfAdding(1, 7), u"Um valor não é aceite neste campo"_s);
    EXPECT_EQ(textOfAdding(1, 1), QString());
}

TEST_F(Writing, ThatAnotherProgramHoldsUpGivesUpInTimeAndCanBeTriedAgain) {
    fill(1);
    const auto rows = open(Movements, connect(1), ado::adLockOptimistic);
    rows->setCollect(u"nome"_s, u"novo"_s);
    book.hold(u"tbMov"_s);
    const QString text = failureOf([&] { rows->Update(); }).text();
    EXPECT_TRUE(text.startsWith(u"Outro posto ou outro programa está a usar"_s));
    EXPECT_TRUE(text.endsWith(support::onServer() ? u"canceling statement due to lock timeout"_s
                                                  : u"database is locked"_s));
    book.letGo();
    rows->Update();
    EXPECT_EQ(book.text(u"SELECT nome FROM tbMov"_s), u"novo"_s);
}

}  // namespace
