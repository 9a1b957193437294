// SPDX-License-Identifier: MIT
#include <QElapsedTimer>
#include <QFile>

#include "SmallBook.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace {

const QString Movements = u"select * from tbMov"_s;

class Reading : public SmallBook {};

qint64 residentKilobytes() {
    QFile file(u"/proc/self/statm"_s);
    return file.open(QIODevice::ReadOnly) ? file.readAll().split(' ').value(1).toLongLong() * 4 : 0;
}

// Also after updates rows come in the order of their insertion. Statements that differ only in the
// values of their conditions share one prepared query.
TEST_F(Reading, GivesTheRowsThatTheStatementAsksForInTheirOrder) {
    book.exec(
        u"INSERT INTO tbMov(socio, tipo, nome, valor, data, obs) VALUES(5,'REP','5',1.5,"
        "'2001-04-01 00:00:00',NULL), (6,'DOC','x''y',-2,'2001-03-31 00:00:00',''),"
        "(5,'PAG','5.0',3,NULL,'0'), (9,'DOC',NULL,0.4,NULL,NULL), (9,'DOC',NULL,-0.3,NULL,NULL);"
        "INSERT INTO tbSoma(socio) VALUES(3), (1), (2);"
        "UPDATE tbMov SET tipo='AAA' WHERE id=3; UPDATE tbSoma SET docs=1 WHERE socio=3;"
        "INSERT INTO tbHosp(nome, code) VALUES('Zita','01'), ('Évora',NULL), (NULL,NULL),"
        "('etc',NULL), ('Eva',NULL), ('água',NULL), ('Ana',NULL), ('eva',NULL)"_s);
    const QString where = Movements + u" where "_s;
    const struct {
        QString statement;
        QString column;
        QString values;
    } table[] = {
        {where + u"socio > 3"_s, u"id"_s, u"1,2,3,4,5"_s},
        {where + u"socio*.5 > 1.5"_s, u"id"_s, u"1,2,3,4,5"_s},
        {u"select socio from tbMov group by socio having (sum(valor) > 0.1)"_s, u"socio"_s, u"5"_s},
        {u"select id, tipo from tbMov where socio=5"_s, u"id"_s, u"1,3"_s},
        {where + u"socio = 6"_s, u"id"_s, u"2"_s},
        {where + u"nome = '5'"_s, u"id"_s, u"1"_s},
        {where + u"valor < -1"_s, u"id"_s, u"2"_s},
        {where + u"data <= CONVERT(DATETIME,'03/31/2001 00:00:00', 102)"_s, u"id"_s, u"2"_s},
        {u"select * from tbHosp order by nome;"_s, u"nome"_s,
         u"NULL,água,Ana,etc,eva,Eva,Évora,Zita"_s},
        {u"select nome, nome + ' x' as quem from tbHosp order by quem desc"_s, u"nome"_s,
         u"Zita,Évora,Eva,eva,etc,Ana,água,NULL"_s},
        {u"select * from tbHosp where nome='EVA'"_s, u"nome"_s, u""_s},
        {u"select socio from tbSoma"_s, u"socio"_s, u"3,1,2"_s},
        {u"select s.socio from ((tbSoma s left join tbMov on s.socio = id))"_s, u"socio"_s,
         u"3,1,2"_s},
        {u"SELECT code + ' - ' + nome AS c FROM tbHosp where hosp_id < 3"_s, u"C"_s,
         u"01 - Zita,NULL"_s},
    };
    for (const auto& row : table)
        EXPECT_EQ(valuesOf(open(row.statement, connection), row.column), row.values)
            << qPrintable(row.statement);
    const auto first = open(u"select nome from tbMov where id = 1"_s, connection);
    const auto second = open(u"select nome from tbMov where id = 2"_s, connection);
    EXPECT_EQ(first->value(0), u"5"_s);
    EXPECT_EQ(second->value(0), u"x'y"_s);
}

// Around the sizes of what is read at a time.
TEST_F(Reading, OfAStaticSetCountsAndPassesTwiceAndSeesNoLaterWrite) {
    for (const int count : {3, 31, 32, 33, 34, 63, 64, 65, 2500}) {
        book.exec(u"DELETE FROM tbMov"_s);
        fill(count);
        const auto rows = open(Movements, connection, ado::adLockOptimistic);
        book.exec(
            u"DELETE FROM tbMov WHERE nome='n2'; UPDATE tbMov SET nome='mudado';"
            "INSERT INTO tbMov(nome) VALUES('novo')"_s);
        for (int pass = 0; pass < 2; ++pass) {
            rows->MoveLast();
            EXPECT_EQ(rows->RecordCount(), count);
            rows->MoveFirst();
            int expected = 0;
            for (; !rows->atEnd(); rows->MoveNext())
                ASSERT_EQ(rows->Collect(u"nome"_s), u"n%1"_s.arg(++expected));
            EXPECT_EQ(expected, count);
        }
        // The open scan hides nothing from the other reads of the connection.
        EXPECT_EQ(open(u"select nome from tbMov where socio=1"_s, connection)->value(0),
                  u"mudado"_s);
    }
}

TEST_F(Reading, OfALongSetNeedsNoMoreMemory) {
    fill(200000);  // some 8 MB of rows
    [[maybe_unused]] const qint64 before = residentKilobytes();
    const auto rows = open(Movements, connection);
    int count = 0;
    for (; !rows->atEnd(); rows->MoveNext()) ++count;
    EXPECT_EQ(count, 200000);
#ifndef __SANITIZE_ADDRESS__
    // The sanitizer keeps what was freed for a while.
    EXPECT_LT(residentKilobytes() - before, 6000);
#endif
}

TEST_F(Reading, KnowsTablesMadeLaterAndAltered) {
    EXPECT_NE(failureOf([&] { open(u"select * from tbNova"_s, connection); }).text(), QString());
    book.exec(u"CREATE TABLE tbNova AS SELECT 1 AS um"_s);
    EXPECT_EQ(open(u"select * from tbNova"_s, connection, ado::adLockReadOnly)->columnCount(), 1);
    book.exec(u"ALTER TABLE tbMov ADD COLUMN nota VARCHAR(7) DEFAULT 'n'"_s);
    fill(1);
    EXPECT_EQ(open(Movements, connection)->Collect(u"nota"_s), u"n"_s);
}

TEST_F(Reading, AndWritingGoOnWithATableThatWasMadeAnew) {
    const auto add = [&] {
        const auto rows = open(u"select * from tbUnico"_s, connection, ado::adLockPessimistic);
        if (!rows->atEnd()) {
            // The row is read afresh behind its lock.
            EXPECT_EQ(rows->value(rows->columnCount() - 1),
                      rows->columnCount() > 1 ? u"n"_s : u"a"_s);
        }
        rows->AddNew();
        rows->setCollect(u"code"_s, u"z"_s);
        rows->Update();
        EXPECT_EQ(rows->Collect(u"code"_s), u"z"_s);
        rows->Delete();
    };
    book.exec(u"INSERT INTO tbUnico (code) VALUES ('a')"_s);
    add();
    book.exec(u"ALTER TABLE tbUnico ADD COLUMN nota VARCHAR(7) DEFAULT 'n'"_s);
    add();
    book.exec(u"DROP TABLE tbUnico"_s);
    EXPECT_NE(failureOf(add).text(), QString());
    book.exec(u"CREATE TABLE tbUnico (chave INTEGER PRIMARY KEY DEFAULT 7, code VARCHAR(3))"_s);
    EXPECT_EQ(failureOf(add).text(), QString());
}

TEST_F(Reading, EndsAStatementThatNeverEnds) {
    const auto brief = connect(1);
    const QString endless =
        u"select count(%1) from (with recursive n(i) as (select 1 union all select i + 1 from n "
        "where i > 0) select i from n) as x"_s;
    EXPECT_EQ(failureOf([&] { open(endless.arg(u'*'), brief); }).code(),
              support::onServer() ? u"57014"_s : u"9"_s);
    // What takes long inside of one step of the engine.
    const QStringList heavy =
        support::onServer()
            ? QStringList{u"repeat('a', 100000 + i)"_s, u"md5(repeat('a', 1000000))"_s,
                          u"nullif(repeat('a', 9000) like repeat('%a', 500) || 'b', true)"_s}
            : QStringList{u"hex(randomblob(900000000))"_s,
                          u"printf('%.900000000c', 'x')"_s,
                          u"hex(randomblob(149000))"_s,
                          u"printf('%200000d', i)"_s,
                          u"replace(hex(zeroblob(149000)), hex(zeroblob(74000)) || '1', i)"_s,
                          u"instr(hex(zeroblob(149000)), hex(zeroblob(74000)) || '1')"_s,
                          u"trim(hex(zeroblob(149000)), '1' || hex(zeroblob(9)))"_s,
                          u"hex(zeroblob(149000)) like '%' || hex(zeroblob(60)) || i"_s,
                          u"hex(zeroblob(149000)) like '%' || hex(zeroblob(490)) || '1'"_s};
    for (const QString& each : heavy) {
        QElapsedTimer taken;
        taken.start();
        const core::Failure failure = failureOf([&] { open(endless.arg(each), brief); });
        EXPECT_EQ(failure.number(), core::DatabaseFailure) << qPrintable(each);
        EXPECT_LT(taken.elapsed(), 6000) << qPrintable(each) << '\n' << failure.what();
    }
    EXPECT_TRUE(open(Movements, brief, ado::adLockReadOnly)->atEnd());
}

TEST_F(Reading, RefusesParametersThatNobodyFills) {
    fill(1);
    for (const QString& typed : {u":x"_s, u"@x"_s, u"$x"_s, u"?1"_s, u"?"_s, u"id::x"_s}) {
        const core::Failure failure = failureOf([&] {
            open(u"select * from tbMov where id = "_s + typed, connection, ado::adLockReadOnly);
        });
        EXPECT_EQ(failure.number(), core::InvalidCall) << qPrintable(typed);
        EXPECT_TRUE(failure.text().contains(u"fora de um texto"_s) ||
                    failure.text().contains(u"«$»"_s))
            << failure.what();
    }
    EXPECT_TRUE(open(u"select * from tbMov where nome = ':x @x $x ?1'"_s, connection)->atEnd());
}

TEST_F(Reading, OfAStatementThatTheEngineRefusesBringsItsText) {
    const core::Failure failure = failureOf([&] { open(u"select nada from tbMov"_s, connection); });
    EXPECT_EQ(failure.text(),
              u"Ao livro falta uma tabela ou uma coluna.\n\nPormenores: %1\n"
              "Tentou-se: «select nada from tbMov»"_s.arg(support::onServer()
                                                              ? u"column \"nada\" does not exist"_s
                                                              : u"no such column: nada"_s));
    EXPECT_EQ(failure.code(), support::onServer() ? u"42703"_s : u"1"_s);
}

TEST_F(Reading, TakesValuesThatWereNeverInABook) {
    const ado::RecordsetPtr set = ado::Recordset::ofValues(
        {{u"Nome"_s, ado::ColumnType::Text},
         {u"valor"_s, ado::ColumnType::Money},
         {u"dia"_s, ado::ColumnType::DateTime},
         {u"docs"_s, ado::ColumnType::Integer32}},
        {{u"Conceição"_s, 12.5, QDateTime(QDate(2026, 11, 24), QTime(0, 0)), 3}, {{}, {}, {}, {}}});
    ASSERT_EQ(set->RecordCount(), 2);
    EXPECT_EQ(set->Collect(u"nome"_s), u"Conceição"_s);
    EXPECT_EQ(core::toText(set->Collect(u"valor"_s)), u"12.5"_s);
    EXPECT_EQ(core::toDate(set->Collect(u"dia"_s)), QDate(2026, 11, 24));
    EXPECT_EQ(set->Collect(u"docs"_s).toInt(), 3);
    set->MoveNext();
    for (int column = 0; column < set->columnCount(); ++column)
        EXPECT_TRUE(core::isNull(set->value(column))) << column;
    set->MoveNext();
    EXPECT_TRUE(set->atEnd());
    EXPECT_EQ(failureOf([&] { set->setCollect(u"nome"_s, u"x"_s); }).number(), core::NoCurrentRow);
    set->MoveFirst();
    EXPECT_EQ(failureOf([&] { set->setCollect(u"nome"_s, u"x"_s); }).number(), core::NotUpdatable);
}

}  // namespace
