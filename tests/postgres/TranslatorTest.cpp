// SPDX-License-Identifier: MIT
// Rules of the translator for this server: name, statement as authors write it, for the server.
#include <gtest/gtest.h>

#include "platform/ado/StatementTranslator.h"

using namespace Qt::StringLiterals;

namespace {

/// tbA has a key of its own, tbB a generated identity, vwA is a view of tbA.
class SmallSchema : public ado::Schema {
public:
    bool isTable(QStringView name) override { return !identity(name).isEmpty(); }
    std::optional<ado::ColumnType> columnType(QStringView table, QStringView column) override {
        static const QHash<QString, ado::ColumnType> columns = {
            {u"id"_s, ado::ColumnType::Integer32},
            {u"nome"_s, ado::ColumnType::Text},
            {u"debito"_s, ado::ColumnType::Money},
            {u"credito_ac"_s, ado::ColumnType::Single}};
        if (!isTable(table) && table.compare(u"vwA", Qt::CaseInsensitive) != 0) return {};
        const auto found = columns.constFind(column.toString().toLower());
        return found == columns.constEnd() ? std::nullopt : std::optional(*found);
    }
    QString identity(QStringView table) override {
        if (table.compare(u"tbA", Qt::CaseInsensitive) == 0) return u"id"_s;
        if (table.compare(u"tbB", Qt::CaseInsensitive) == 0) return u"_linha"_s;
        return {};
    }
};

struct Rule {
    const char* name;
    QString before;
    QString after;
};

class ServerTranslator : public testing::TestWithParam<Rule> {};

const Rule Rules[] = {
    {"NameInBrackets", u"SELECT max([Id]) FROM `TbA`"_s, u"SELECT max(\"id\") FROM \"tba\""_s},
    {"KeywordAsName", u"SELECT max(tbA.Order) FROM tbA"_s, u"SELECT max(tbA.\"order\") FROM tbA"_s},
    {"SumOfAmountsStays", u"SELECT Sum(debito) FROM tbA"_s, u"SELECT Sum(debito) FROM tbA"_s},
    {"SumOfFloats", u"SELECT Sum(tbB.credito_ac) AS s FROM tbB"_s,
     u"SELECT Sum(CAST(tbB.credito_ac AS double precision)) AS s FROM tbB"_s},
    {"NumberBesideText", u"SELECT max(id) FROM tbA WHERE tbA.nome = 5 AND id >= 5 AND nome<>007"_s,
     u"SELECT max(id) FROM tbA WHERE tbA.nome = '5' AND id >= 5 AND nome<>'007'"_s},
    {"NullsFirst", u"SELECT * FROM tbA ORDER BY nome, debito DESC, id"_s,
     u"SELECT * FROM tbA ORDER BY nome NULLS FIRST, debito DESC NULLS LAST, id"_s},
    {"OrderByAlias", u"SELECT nome + ' ' AS quem FROM vwA ORDER BY quem ASC;"_s,
     u"SELECT nome || ' ' AS quem FROM vwA ORDER BY quem ASC NULLS FIRST"_s},
    {"OrderBehindUnion",
     u"SELECT tbA.nome AS quem FROM tbA UNION SELECT tbB.nome FROM tbB ORDER BY tbA.nome"_s,
     u"SELECT * FROM (SELECT tbA.nome AS quem FROM tbA UNION SELECT tbB.nome FROM tbB ) AS uniao "
     u"ORDER BY quem NULLS FIRST"_s},
    {"InsertionOrder", u"Select nome from TBB where nome > 'a'"_s,
     u"Select nome from TBB where nome > 'a' ORDER BY \"tbb\"._linha"_s},
    {"InsertionOrderOfJoins", u"SELECT x.id FROM ((tbA AS X LEFT JOIN tbB ON x.id = tbB.id))"_s,
     u"SELECT x.id FROM ((tbA AS X LEFT JOIN tbB ON x.id = tbB.id)) ORDER BY \"x\".id"_s},
    {"AggregateInACall", u"SELECT round(max(id), 2) FROM tbA"_s,
     u"SELECT round(max(id), 2) FROM tbA"_s},
    {"AggregateOfAnInnerSelect", u"SELECT id, (SELECT max(id) FROM tbB) FROM tbA"_s,
     u"SELECT id, (SELECT max(id) FROM tbB) FROM tbA ORDER BY \"tba\".id"_s},
};

}  // namespace

TEST_P(ServerTranslator, Rule) {
    SmallSchema schema;
    EXPECT_EQ(
        ado::translate(ado::Statement(GetParam().before), schema, false, ado::Dialect::Postgres),
        GetParam().after);
}

INSTANTIATE_TEST_SUITE_P(, ServerTranslator, testing::ValuesIn(Rules),
                         [](const auto& rule) { return std::string(rule.param.name); });

TEST(ServerStatement, IdentityStandsBeforeTheColumns) {
    SmallSchema schema;
    EXPECT_EQ(ado::translate(ado::Statement(u"select * from tbB where id=1;"_s), schema, true,
                             ado::Dialect::Postgres),
              u"select _linha,* from tbB where id=1 ORDER BY \"tbb\"._linha"_s);
}
