// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "coverage/Queries.h"
#include "tests/support/Book.h"

using namespace Qt::StringLiterals;

namespace {

TEST(Schema, TwinsHaveTheSameColumnsInTheSameOrderAndTheHistoryHasThemAll) {
    support::Book book;
    const QString columns = u"select lower(name), type from pragma_table_info('%1')"_s;
    for (const QString& table : {u"tbZelmar_Movimentos"_s, u"tbSocios"_s, u"tbSocios_Familias"_s,
                                 u"tbSocios_Acumulados"_s}) {
        EXPECT_EQ(book.text(columns.arg(table)), book.text(columns.arg(table + u"_Inactivos"_s)));
        EXPECT_NE(book.text(columns.arg(table)), QString()) << qPrintable(table);
    }
    EXPECT_EQ(book.text(u"select name from pragma_table_info('tbZelmar_Movimentos') "
                        "where name not in ('movimento_id', 'upsize_ts') and name not in "
                        "(select name from pragma_table_info('tbZelmar_Movimentos_Historico'))"_s),
              QString());
}

TEST(Schema, ANewBookHasItsCodesAndStartsToCountAtOne) {
    support::Book book;
    EXPECT_EQ(book.text(u"select group_concat(code) from "
                        "(select code from tbZelmar_movimentos_tipos order by code)"_s),
              u"ANL,COR,DOC,HOS,PAG,REP,SA"_s);
    EXPECT_EQ(book.count(u"tbModos_Pagamento"_s, u"code in ('CHQ', 'TRF', 'ANL')"_s), 3);
    EXPECT_EQ(book.text(u"select * from tbContadores, tbCheques"_s), u"1|1"_s);
}

TEST(MovementsInForce, ShowBothTablesWithNamesAndWhereEachRowLives) {
    support::Book book;
    const qint64 socio = book.member({.no_kor = "100015", .nome = "Ana Sá"});
    book.person({.socio_id = socio, .codABC = "C1", .nome = "Rui Sá"});
    book.person({.socio_id = socio, .codABC = "C1", .nome = "a code given twice"});
    book.exec(u"insert into tbSocios_Inactivos (socio_id, no_kor, nome) values (70, '99', 'Zé')"_s);
    book.exec(
        u"insert into tbZelmar_Movimentos (socio_id, codABC, tipo) values "
        "(%1, 'C1', 'DOC'), (%1, null, 'SA'), (4711, 'A', 'ANL')"_s.arg(socio));
    book.exec(
        u"insert into tbZelmar_Movimentos_Inactivos (movimento_id, socio_id, tipo) "
        "values (9, 70, 'PAG')"_s);
    EXPECT_EQ(book.text(u"select movimento_id, tipo, ficheiro, no_kor, nome, familiar from "
                        "vwZelmars_Movimentos_Vigor order by movimento_id"_s),
              u"1|DOC|ACTIVO|100015|Ana Sá|Rui Sá\n"
              "2|SA|ACTIVO|100015|Ana Sá|NULL\n"
              "3|ANL|ACTIVO|NULL|NULL|NULL\n"
              "9|PAG|INACTIVO|99|Zé|NULL"_s);
}

TEST(MovementsInForce, AnIdNamesOneMovementInBothTables) {
    support::Book book;
    for (const QString& twin : {u""_s, u"_Inactivos"_s, u""_s})
        book.insert(u"tbZelmar_Movimentos"_s + twin, {{"tipo", u"DOC"_s}});
    EXPECT_EQ(book.text(u"select count(distinct movimento_id) from vwZelmars_Movimentos_Vigor"_s),
              u"3"_s);
}

/// What people wait for at the keyboard; each is reached by a key, however large the book.
TEST(Schema, DailyStatementsDoNotReadWholeTables) {
    using namespace coverage::queries;
    // Rows of one table are read in the order of their insertion.
    const auto rows = [](const QString& statement) { return statement + u" %1"_s; };
    const QStringList statements{
        rows(rubric(3)),
        rows(accumulator(3, 5, u"C1"_s)),
        creditOfHousehold(3, 5),
        creditOfRelatives(3, 5),
        groupCreditOfPerson(1, u"C1"_s, 5),
        groupCreditOfHousehold(1, 5),
        groupCreditOfRelatives(1, 5),
        balance(5),
        franchise(5, 3),
        rows(member(5)),
        u"SELECT * FROM vwZelmars_Movimentos_Vigor WHERE movimento_id = 5"_s,
        rows(u"select * from tbzelmar_movimentos where movimento_id = 0"_s),
        rows(u"select * from tbSocios where no_kor ='100015'"_s),
        rows(u"select * from tbQuotas_Socios where socio_id=5"_s),
        rows(u"select * from tbQuotas_Movimentos where tbQuotas_Movimentos.socio_id=5"_s),
        rows(u"Select * from tbsocios_familias where socio_familia_id =5"_s),
        rows(u"select * from tbSocios_Familias where socio_id = 5"_s),
        rows(u"Select * from tbSocios_Acumulados WHERE (socio_id=5) and (rubrica_id_main=0)"_s),
        rows(u"Select * from tbSocios_Acumulados_Inactivos WHERE (rubrica_id =3) AND "
             "(socio_id=5) AND (codABC='A')"_s),
        u"select socio_id, sum(debito) from tbZelmar_Movimentos where data >= '2026-01-01' and "
        "data <= '2026-01-31' group by socio_id"_s,
        rows(u"select * from tbZelmar_movimentos_historico where no_kor ='100015'"_s),
    };
    support::Book book;
    const auto made = support::BookHandle::makeOnServer(support::Book::Content::Empty);
    support::BookHandle& server = *made;
    server.rows(u"set enable_seqscan = off"_s);  // where a key serves at all, it is taken
    for (QString statement : statements) {
        const QString plan = book.text(u"explain query plan "_s +
                                       QString(statement).replace(u"%1"_s, u"ORDER BY _rowid_"_s));
        EXPECT_TRUE(plan.contains(u"SEARCH"_s)) << qPrintable(statement + u'\n' + plan);
        EXPECT_FALSE(plan.contains(u"SCAN"_s)) << qPrintable(statement + u'\n' + plan);
        for (const QStringList& step : server.rows(u"explain "_s + statement.remove(u"%1"_s)))
            EXPECT_FALSE(step[0].contains(u"Seq Scan"_s)) << qPrintable(statement + step[0]);
    }
}

}  // namespace
