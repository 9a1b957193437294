// SPDX-License-Identifier: MIT
// What is no single query changes nothing, however it is dressed up for this server.
#include "ServerBook.h"

using namespace Qt::StringLiterals;

namespace {

class Safety : public ServerBook {};

}  // namespace

TEST_F(Safety, WhatIsNoQueryChangesNothing) {
    fill(1);
    const QString state =
        u"SELECT (SELECT string_agg(nome, ',') FROM tbMov) || (SELECT count(*) FROM pg_class) || "
        u"(SELECT count(*) FROM pg_roles)"_s;
    const QString before = exec(state);
    const char* const texts[] = {
        "",
        ";",
        "-- nada",
        "DELETE FROM tbMov",
        "TRUNCATE tbMov",
        "COPY tbMov TO '/tmp/x'",
        "UPDATE tbMov SET nome='x'",
        "INSERT INTO tbMov(nome) VALUES('x')",
        "DROP TABLE tbMov",
        "DO $$BEGIN DELETE FROM tbMov; END$$",
        "CALL x()",
        "SET ROLE postgres",
        "COMMIT",
        "WITH x AS (DELETE FROM tbMov RETURNING *) SELECT * FROM x",
        "SELECT 1; DELETE FROM tbMov",
        "select * from tbMov where nome =''; DROP TABLE tbMov; --'",
        "SELECT E'\\''; DELETE FROM tbMov; --'",
        "SELECT E'\\\\\\'; DELETE FROM tbMov; --'",
        "SELECT $$'$$; DELETE FROM tbMov; --'",
        "SELECT $x$ ' $x$; DELETE FROM tbMov; --'",
        "SELECT U&'\\0027'; DELETE FROM tbMov; --'",
        "SELECT 1 /* /* */ ; DELETE FROM tbMov; --*/",
        "SELECT 1 INTO tbOutra",
        "SELECT * INTO tbOutra FROM tbMov",
        "SELECT * FROM tbMov FOR UPDATE",
        "select * from (select 1) x; commit; delete from tbMov",
        "SELECT nextval('tbmov_id_seq')",
        "SELECT setval('tbmov_id_seq', 99)",
        "select * from tbMov where nome ='d'Almeida'",
        "select nada from tbMov",
        "SHAPE {DELETE FROM tbMov} APPEND ({SELECT 1} RELATE a TO b) AS c",
        "SHAPE {SELECT id FROM tbMov} APPEND ({DELETE FROM tbMov} RELATE id TO id) AS c"};
    const auto shaping = connect(5, u"MSDataShape.1"_s);
    for (const char* text : texts) {
        EXPECT_NE(failureOf([&] { open(QString::fromUtf8(text), shaping); }).number(), 0) << text;
        ASSERT_EQ(exec(state), before) << text;
    }
    EXPECT_EQ(exec(u"SELECT last_value FROM tbmov_id_seq"_s), u"1"_s);
    EXPECT_EQ(open(u"select nome from tbMov"_s, shaping)->value(0), u"n1"_s);
}

TEST_F(Safety, QuotesAndBackslashesInTextsStayTexts) {
    exec(u"INSERT INTO tbMov(nome) VALUES('a\\; -- b''')"_s);
    const auto rows = open(u"select * from tbMov where nome='a\\; -- b''' ;;"_s, connection);
    EXPECT_EQ(rows->Collect(u"nome"_s), u"a\\; -- b'"_s);
    try {
        open(u"select nada from tbMov"_s, connection);
        FAIL() << "opened";
    } catch (const core::Failure& failure) {
        EXPECT_EQ(failure.text(), u"column \"nada\" does not exist"_s);
        EXPECT_EQ(failure.code(), u"42703"_s);
    }
}
