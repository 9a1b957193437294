// SPDX-License-Identifier: MIT
// What is no single query never reaches the book, however it is dressed up.
#include <gtest/gtest.h>

#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

class Refused : public testing::TestWithParam<const char*> {};

}  // namespace

TEST_P(Refused, ChangesNothing) {
    SmallBook book;
    book.exec(u"INSERT INTO tbMov(nome) VALUES('fica')"_s);
    const QString before = book.value(u"SELECT group_concat(sql) FROM sqlite_schema"_s);
    const auto connection = book.connect(u"MSDataShape.1"_s);
    EXPECT_NE(failureOf([&] { openRows(QString::fromUtf8(GetParam()), connection); }), QString());
    EXPECT_EQ(book.value(u"SELECT nome FROM tbMov"_s), u"fica"_s);
    EXPECT_EQ(book.value(u"SELECT group_concat(sql) FROM sqlite_schema"_s), before);
}

INSTANTIATE_TEST_SUITE_P(
    Texts, Refused,
    testing::Values(
        "", " ", ";", "-- nada", "DELETE FROM tbMov", "delete/**/from tbMov",
        "UPDATE tbMov SET nome='x'", "INSERT INTO tbMov(nome) VALUES('x')", "DROP TABLE tbMov",
        "CREATE TABLE x(y)", "PRAGMA query_only=0", "ATTACH 'x.db' AS x", "VACUUM", "BEGIN",
        "EXPLAIN SELECT 1", "VALUES(1)", "WITH x AS (SELECT 1) DELETE FROM tbMov",
        "REPLACE INTO tbMov(nome) VALUES('x')", "SELECT 1; DELETE FROM tbMov",
        "SELECT 1;;DELETE FROM tbMov;", "select * from tbMov where nome =''; DROP TABLE tbMov; --'",
        "select * from tbMov where nome ='a' ; -- \n delete from tbMov",
        "select 1 /* ; */ ; /* x */ delete from tbMov",
        "select * from tbMov where nome ='d'Almeida'", "select * from tbMov where nome ='",
        "select \"x", "select [x", "select 1 /* aberto", "select `x; delete from tbMov",
        "SHAPE {DELETE FROM tbMov} APPEND ({SELECT 1} RELATE a TO b) AS c",
        "SHAPE {SELECT id FROM tbMov} APPEND ({DELETE FROM tbMov} RELATE id TO id) AS c",
        "SHAPE {SELECT id FROM tbMov}", "SHAPE {SELECT id FROM tbMov", "select load_extension('x')",
        "select * from nada", "select nada from tbMov"));

TEST(Statements, WithANullCharacterAreNotCut) {
    SmallBook book;
    const QString text = u"select * from tbMov where 1=1"_s + QChar(u'\0') + u" and 1=0"_s;
    EXPECT_TRUE(failureOf([&] { openRows(text, book.connect()); }).contains(u"nulo"_s));
}

TEST(Statements, MayHoldSemicolonsAndCommentsInTexts) {
    SmallBook book;
    book.exec(u"INSERT INTO tbMov(nome) VALUES('a; -- b''')"_s);
    const auto rows = openRows(u"select * from tbMov where nome='a; -- b''' ;;"_s, book.connect());
    EXPECT_EQ(rows->Collect(u"nome"_s), u"a; -- b'"_s);
}

TEST(Statements, CarryTheEnginesTextAndCode) {
    SmallBook book;
    const auto connection = book.connect();
    try {
        openRows(u"select nada from tbMov"_s, connection);
        FAIL() << "opened";
    } catch (const core::Failure& failure) {
        EXPECT_EQ(failure.text(), u"no such column: nada"_s);
        EXPECT_EQ(failure.number(), core::DatabaseFailure);
        EXPECT_EQ(failure.code(), u"1"_s);
    }
}
