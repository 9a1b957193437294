// SPDX-License-Identifier: MIT
// Each rule of the translator is a row: name, statement as authors write it, for SQLite, for
// PostgreSQL. Without a text for an engine the statement stays as it is.
#include <gtest/gtest.h>

#include <QHash>

#include "platform/ado/StatementTranslator.h"
#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;

namespace {

/// tbA has a key of its own, tbB an identity that the server generates, vwA is a view of tbA.
class SmallSchema : public ado::Schema {
public:
    explicit SmallSchema(ado::Dialect dialect) : dialect_(dialect) {}
    bool isTable(QStringView name) override {
        return QStringList({u"tbA"_s, u"tbB"_s}).contains(name, Qt::CaseInsensitive);
    }
    std::optional<ado::ColumnType> columnType(QStringView table, QStringView column) override {
        using enum ado::ColumnType;
        static const QHash<QString, ado::ColumnType> types = {
            {u"id"_s, Integer32}, {u"nome"_s, Text},     {u"code"_s, Text},
            {u"debito"_s, Money}, {u"credito"_s, Money}, {u"credito_ac"_s, Single}};
        const auto type = types.constFind(column.toString().toLower());
        const bool known = isTable(table) || table.compare(u"vwA", Qt::CaseInsensitive) == 0;
        return known && type != types.constEnd() ? std::optional(*type) : std::nullopt;
    }
    QString identity(QStringView table) override {
        if (dialect_ == ado::Dialect::Sqlite || !isTable(table)) return Schema::identity(table);
        return table.endsWith(u'A') ? u"id"_s : u"_linha"_s;
    }

private:
    ado::Dialect dialect_;
};

struct Rule {
    const char* name;
    QString before;
    QString sqlite = {};
    QString postgresql = {};
};

const Rule Rules[] = {
    {"ConvertWithoutTime", u"SELECT max(id) FROM tbA WHERE d < convert(datetime , '1/2/2001')"_s,
     u"SELECT max(id) FROM tbA WHERE d < '2001-01-02 00:00:00'"_s,
     u"SELECT max(id) FROM tbA WHERE d < '2001-01-02 00:00:00'"_s},
    {"DateBetweenSigns", u"SELECT max(id) FROM tbA WHERE d=#2/22/2000#"_s,
     u"SELECT max(id) FROM tbA WHERE d='2000-02-22 00:00:00'"_s,
     u"SELECT max(id) FROM tbA WHERE d='2000-02-22 00:00:00'"_s},
    {"TextBetweenDoubleQuotes", u"SELECT max(id) FROM tbA WHERE nome=\"o'R\""_s,
     u"SELECT max(id) FROM tbA WHERE nome='o''R'"_s,
     u"SELECT max(id) FROM tbA WHERE nome='o''R'"_s},
    {"NameInBrackets", u"SELECT max([Id]) FROM `TbA`"_s, {}, u"SELECT max(\"id\") FROM \"tba\""_s},
    {"KeywordAsName", u"SELECT max(tbA.Order) FROM tbA"_s, u"SELECT max(tbA.\"Order\") FROM tbA"_s,
     u"SELECT max(tbA.\"order\") FROM tbA"_s},

    {"WholeChainIsJoined", u"SELECT max(a.b + c + f(d) + ' ' + (e)) FROM tbA"_s,
     u"SELECT max(a.b || c || f(d) || ' ' || (e)) FROM tbA"_s,
     u"SELECT max(a.b || c || f(d) || ' ' || (e)) FROM tbA"_s},
    {"NumbersAreAdded", u"SELECT max(a + b), max(c + ' ') FROM tbA"_s,
     u"SELECT max(a + b), max(c || ' ') FROM tbA"_s,
     u"SELECT max(a + b), max(c || ' ') FROM tbA"_s},

    {"DifferenceOfSums", u"SELECT (SUM(debito) - SUM(credito)) FROM tbA"_s,
     u"SELECT (ROUND(SUM(debito) - SUM(credito),4)) FROM tbA"_s},
    {"SumOfDifference", u"SELECT Sum(tbA.debito-credito) AS d FROM tbA"_s,
     u"SELECT ROUND(Sum(tbA.debito-credito),4) AS d FROM tbA"_s},
    {"SumOfFloats",
     u"SELECT Sum(tbB.credito_ac), Sum(id) FROM tbB"_s,
     {},
     u"SELECT Sum(CAST(tbB.credito_ac AS double precision)), Sum(id) FROM tbB"_s},
    {"DifferenceAndProductOfAmounts",
     u"SELECT id, vwA.debito - credito AS d, debito*(200.482) as e FROM vwA WHERE id-1>0"_s,
     u"SELECT id, ROUND(vwA.debito - credito,4) AS d, ROUND(debito*(200.482),7) as e FROM vwA "
     "WHERE id-1>0"_s},
    {"NumberBeforeAKeyword", u"SELECT max(id) FROM tbA WHERE id=44AND id<1e5GROUP BY f()"_s,
     u"SELECT max(id) FROM tbA WHERE id=44 AND id<1e5GROUP BY f()"_s,
     u"SELECT max(id) FROM tbA WHERE id=44 AND id<1e5GROUP BY f()"_s},
    {"NumberBesideText",
     u"SELECT max(id) FROM tbA WHERE tbA.nome = 5 AND id >= 5 AND nome<>007"_s,
     {},
     u"SELECT max(id) FROM tbA WHERE tbA.nome = '5' AND id >= 5 AND nome<>'007'"_s},

    {"NullsFirst", u"SELECT * FROM tbA ORDER BY nome, debito DESC, id"_s,
     u"SELECT * FROM tbA ORDER BY nome COLLATE portuguese, debito DESC, id, \"tbA\"._rowid_"_s,
     u"SELECT * FROM tbA ORDER BY nome NULLS FIRST, debito DESC NULLS LAST, id"_s},
    {"OrderByJoinedText", u"SELECT id, code + ' ' + nome AS completo FROM vwA ORDER BY completo;"_s,
     u"SELECT id, code || ' ' || nome AS completo FROM vwA ORDER BY completo COLLATE portuguese"_s,
     u"SELECT id, code || ' ' || nome AS completo FROM vwA ORDER BY completo NULLS FIRST"_s},
    {"EqualRowsOfAnOrder", u"SELECT nome FROM tbB ORDER BY debito DESC LIMIT 5"_s,
     u"SELECT nome FROM tbB ORDER BY debito DESC, \"tbB\"._rowid_ LIMIT 5"_s,
     u"SELECT nome FROM tbB ORDER BY debito DESC NULLS LAST, \"tbb\"._linha LIMIT 5"_s},
    {"OrderOfGroups",
     u"SELECT id FROM vwA GROUP BY id,vwA.nome, f(debito) HAVING max(debito) > 1 ORDER BY debito"_s,
     u"SELECT id FROM vwA GROUP BY id,vwA.nome, f(debito) HAVING max(debito) > 1 ORDER BY debito, "
     "id,vwA.nome COLLATE portuguese"_s,
     u"SELECT id FROM vwA GROUP BY id,vwA.nome, f(debito) HAVING max(debito) > 1 ORDER BY debito "
     "NULLS FIRST, id NULLS FIRST,vwA.nome NULLS FIRST"_s},
    {"OrderBehindUnion",
     u"SELECT tbA.id, tbA.nome AS quem FROM tbA UNION SELECT tbB.id, tbB.nome FROM tbB ORDER BY "
     "tbA.nome"_s,
     u"SELECT * FROM (SELECT tbA.id, tbA.nome AS quem FROM tbA UNION SELECT tbB.id, tbB.nome FROM "
     "tbB ) ORDER BY quem COLLATE portuguese, 1,2"_s,
     u"SELECT * FROM (SELECT tbA.id, tbA.nome AS quem FROM tbA UNION SELECT tbB.id, tbB.nome FROM "
     "tbB ) AS uniao ORDER BY quem NULLS FIRST, 1 NULLS FIRST,2 NULLS FIRST"_s},
    {"UnionWithoutOrder", u"SELECT id FROM tbA UNION SELECT id FROM tbB"_s,
     u"SELECT id FROM tbA UNION SELECT id FROM tbB ORDER BY 1"_s,
     u"SELECT id FROM tbA UNION SELECT id FROM tbB ORDER BY 1 NULLS FIRST"_s},
    {"UnionOfAllRows", u"SELECT id FROM tbA UNION ALL SELECT id FROM tbB"_s},
    {"OrderBehindUnionWithoutAlias",
     u"SELECT tbA.* FROM tbA UNION SELECT tbB.* FROM tbB ORDER BY tbA.id"_s,
     u"SELECT * FROM (SELECT tbA.* FROM tbA UNION SELECT tbB.* FROM tbB ) ORDER BY id"_s,
     u"SELECT * FROM (SELECT tbA.* FROM tbA UNION SELECT tbB.* FROM tbB ) AS uniao ORDER BY id "
     "NULLS FIRST"_s},

    {"InsertionOrder", u"Select nome from TBB where nome > 'a'"_s,
     u"Select nome from TBB where nome > 'a' ORDER BY \"TBB\"._rowid_"_s,
     u"Select nome from TBB where nome > 'a' ORDER BY \"tbb\"._linha"_s},
    {"InsertionOrderOfJoin", u"SELECT X.id FROM tbA AS X LEFT JOIN tbB ON x.id = tbB.id"_s,
     u"SELECT X.id FROM tbA AS X LEFT JOIN tbB ON x.id = tbB.id ORDER BY \"X\"._rowid_"_s,
     u"SELECT X.id FROM tbA AS X LEFT JOIN tbB ON x.id = tbB.id ORDER BY \"x\".id"_s},
    {"InsertionOrderOfJoinInBrackets",
     u"SELECT x.id FROM ((tbA x LEFT JOIN tbB ON x.id = tbB.id))"_s,
     {},
     u"SELECT x.id FROM ((tbA x LEFT JOIN tbB ON x.id = tbB.id)) ORDER BY \"x\".id"_s},
    {"ViewHasNoInsertionOrder", u"SELECT * FROM vwA WHERE id = 1"_s},
    {"AggregateInACall", u"SELECT round(max(id), 2) FROM tbA"_s},
    {"AggregateOfAnInnerSelect", u"SELECT id, (SELECT max(id) FROM tbB) FROM tbA"_s,
     u"SELECT id, (SELECT max(id) FROM tbB) FROM tbA ORDER BY \"tbA\"._rowid_"_s,
     u"SELECT id, (SELECT max(id) FROM tbB) FROM tbA ORDER BY \"tba\".id"_s},
    {"UnknownStays", u"SELECT top 5 max(x) OVER w ~ !%& {fn now()} @a ?:b"_s},
};

class Translator : public testing::TestWithParam<Rule> {};

TEST_P(Translator, Keeps) {
    const Rule& rule = GetParam();
    for (const auto& [dialect, after] : {std::pair(ado::Dialect::Sqlite, rule.sqlite),
                                         {ado::Dialect::Postgres, rule.postgresql}}) {
        SmallSchema schema(dialect);
        EXPECT_EQ(ado::translate(ado::Statement(rule.before), schema, false, dialect),
                  after.isNull() ? rule.before : after);
    }
}

INSTANTIATE_TEST_SUITE_P(Rule, Translator, testing::ValuesIn(Rules),
                         [](const auto& rule) { return std::string(rule.param.name); });

TEST(Statement, IsReadWithItsIdentityBeforeTheColumns) {
    const ado::Statement statement(u"select * from tbB where id=1;"_s);
    SmallSchema file(ado::Dialect::Sqlite);
    EXPECT_EQ(ado::translate(statement, file, true),
              u"select _rowid_,* from tbB where id=1 ORDER BY \"tbB\"._rowid_"_s);
    SmallSchema server(ado::Dialect::Postgres);
    EXPECT_EQ(ado::translate(statement, server, true, ado::Dialect::Postgres),
              u"select _linha,* from tbB where id=1 ORDER BY \"tbb\"._linha"_s);
}

}  // namespace
