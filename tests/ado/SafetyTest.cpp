// SPDX-License-Identifier: MIT
// What is no single query never reaches the book, however it is dressed up.
#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

class Statements : public SmallBook {};

TEST_F(Statements, ThatAreNoSingleQueryChangeNothing) {
    const QString schema = u"SELECT group_concat(sql) FROM sqlite_schema"_s;
    const QString before = book.text(schema);
    book.exec(u"INSERT INTO tbMov(nome) VALUES('fica')"_s);
    ado::ConnectionPtr shaping = std::make_shared<ado::Connection>();
    shaping->ConnectionString = book.shapingConnectionString();
    shaping->Open();
    for (const char* text :
         {"", "delete/**/from tbMov", "UPDATE tbMov SET nome='x'", "DROP TABLE tbMov",
          "PRAGMA query_only=0", "ATTACH 'x.db' AS x", "WITH x AS (SELECT 1) DELETE FROM tbMov",
          "SELECT 1; DELETE FROM tbMov",
          "select * from tbMov where nome =''; DROP TABLE tbMov; --'",
          "select * from tbMov where nome ='a' ; -- \n delete from tbMov",
          "select 1 /* ; */ ; /* x */ delete from tbMov",
          "select * from tbMov where nome ='d'Almeida'", "select * from tbMov where nome ='",
          "select `x; delete from tbMov",
          "SHAPE {DELETE FROM tbMov} APPEND ({SELECT 1} RELATE a TO b) AS c",
          "SHAPE {SELECT id FROM tbMov} APPEND ({DELETE FROM tbMov} RELATE id TO id) AS c",
          "select load_extension('x')"}) {
        SCOPED_TRACE(text);
        EXPECT_NE(failureOf([&] { open(QString::fromUtf8(text), shaping); }).text(), QString());
        EXPECT_EQ(book.text(u"SELECT nome FROM tbMov"_s), u"fica"_s);
        EXPECT_EQ(book.text(schema), before);
    }
    const QString cut = u"select * from tbMov where 1=1"_s + QChar(u'\0') + u" and 1=0"_s;
    EXPECT_TRUE(failureOf([&] { open(cut, connection); }).text().contains(u"nulo"_s));
}

}  // namespace
