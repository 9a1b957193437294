// SPDX-License-Identifier: MIT
#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

const QString Movements = u"select * from tbMov"_s;

class Reading : public SmallBook {};

// Also after updates rows come in the order of their insertion. Statements that differ only in the
// values of their conditions share one prepared query.
TEST_F(Reading, GivesTheRowsThatTheStatementAsksForInTheirOrder) {
    book.exec(
        u"INSERT INTO tbMov(socio, tipo, nome, valor, data, obs) VALUES(5,'REP','5',1.5,"
        "'2001-04-01 00:00:00',NULL), (6,'DOC','x''y',-2,'2001-03-31 00:00:00',''),"
        "(5,'PAG','5.0',3,NULL,'0');"
        "UPDATE tbMov SET tipo='AAA' WHERE id=3;"
        "INSERT INTO tbHosp(nome, code) VALUES('Zita','01'), ('Évora',NULL), (NULL,NULL),"
        "('etc',NULL), ('Eva',NULL), ('água',NULL), ('Ana',NULL), ('eva',NULL)"_s);
    const QString where = Movements + u" where "_s;
    const struct {
        QString statement;
        QString column;
        QString values;
    } table[] = {
        {where + u"socio > 3"_s, u"id"_s, u"1,2,3"_s},
        {u"select id, tipo from tbMov where socio=5"_s, u"id"_s, u"1,3"_s},
        {where + u"socio = 6"_s, u"id"_s, u"2"_s},
        {where + u"nome = '5'"_s, u"id"_s, u"1"_s},
        {where + u"valor < -1"_s, u"id"_s, u"2"_s},
        {where + u"data <= CONVERT(DATETIME,'03/31/2001 00:00:00', 102)"_s, u"id"_s, u"2"_s},
        {u"select * from tbHosp order by nome;"_s, u"nome"_s,
         u"NULL,água,Ana,etc,eva,Eva,Évora,Zita"_s},
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
    for (const int count : {3, 31, 32, 33, 34, 400}) {
        book.exec(u"DELETE FROM tbMov; DELETE FROM sqlite_sequence"_s);
        fill(count);
        const auto rows = open(Movements, connection, ado::adLockOptimistic);
        book.exec(
            u"UPDATE tbMov SET nome='mudado'; INSERT INTO tbMov(nome) VALUES('novo');"
            "DELETE FROM tbMov WHERE id=2"_s);
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
        EXPECT_EQ(open(u"select nome from tbMov where id=1"_s, connection)->value(0), u"mudado"_s);
    }
}

}  // namespace
