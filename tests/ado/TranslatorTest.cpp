// SPDX-License-Identifier: MIT
// Each rule of the translator is a row: name, statement as authors write it, statement for SQLite.
#include <gtest/gtest.h>

#include <QHash>

#include "platform/ado/StatementTranslator.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace {

/// Tables tbA and tbB with columns of each kind, and a view vwA of tbA.
class SmallSchema : public ado::Schema {
public:
    bool isTable(QStringView name) override {
        return QStringList({u"tbA"_s, u"tbB"_s}).contains(name, Qt::CaseInsensitive);
    }
    std::optional<ado::ColumnType> columnType(QStringView table, QStringView column) override {
        using enum ado::ColumnType;
        static const QHash<QString, ado::ColumnType> types = {
            {u"id"_s, Integer32}, {u"nome"_s, Text},     {u"code"_s, Text},
            {u"debito"_s, Money}, {u"credito"_s, Money}, {u"credito_ac"_s, Single}};
        const auto type = types.constFind(column.toString().toLower());
        const bool known = isTable(table) || table == u"vwA";
        return known && type != types.constEnd() ? std::optional(*type) : std::nullopt;
    }
};

struct Rule {
    const char* name;
    QString before;
    QString after = before;
};

const Rule Rules[] = {
    {"ConvertWithoutTime", u"SELECT max(id) FROM tbA WHERE d < convert(datetime , '1/2/2001')"_s,
     u"SELECT max(id) FROM tbA WHERE d < '2001-01-02 00:00:00'"_s},
    {"DateBetweenSigns", u"SELECT max(id) FROM tbA WHERE d=#2/22/2000#"_s,
     u"SELECT max(id) FROM tbA WHERE d='2000-02-22 00:00:00'"_s},

    {"WholeChainIsJoined", u"SELECT max(a.b + c + f(d) + ' ' + (e)) FROM tbA"_s,
     u"SELECT max(a.b || c || f(d) || ' ' || (e)) FROM tbA"_s},
    {"NumbersAreAdded", u"SELECT max(a + b), max(c + ' ') FROM tbA"_s,
     u"SELECT max(a + b), max(c || ' ') FROM tbA"_s},

    {"DifferenceOfSums",
     u"SELECT id FROM tbA GROUP BY id HAVING ((SUM(debito) - SUM(credito)) > 0.1)"_s,
     u"SELECT id FROM tbA GROUP BY id HAVING ((ROUND(SUM(debito) - SUM(credito),4)) > 0.1)"_s},
    {"SumOfDifference", u"SELECT Sum(tbA.debito-credito) AS d FROM tbA"_s,
     u"SELECT ROUND(Sum(tbA.debito-credito),4) AS d FROM tbA"_s},
    {"SumsOfFloatsAndCountsStay", u"SELECT Sum(credito_ac), Sum(id) FROM tbA"_s},

    {"OrderByJoinedText", u"SELECT id, code + ' ' + nome AS completo FROM tbA ORDER BY completo"_s,
     u"SELECT id, code || ' ' || nome AS completo FROM tbA ORDER BY completo COLLATE portuguese"_s},
    {"OrderBehindUnion",
     u"SELECT tbA.id, tbA.nome AS quem FROM tbA UNION SELECT tbB.id, tbB.nome FROM tbB ORDER BY "
     "tbA.nome"_s,
     u"SELECT * FROM (SELECT tbA.id, tbA.nome AS quem FROM tbA UNION SELECT tbB.id, tbB.nome FROM "
     "tbB ) ORDER BY quem COLLATE portuguese"_s},
    {"OrderBehindUnionWithoutAlias",
     u"SELECT tbA.* FROM tbA UNION SELECT tbB.* FROM tbB ORDER BY tbA.id"_s,
     u"SELECT * FROM (SELECT tbA.* FROM tbA UNION SELECT tbB.* FROM tbB ) ORDER BY id"_s},

    {"InsertionOrder", u"Select id from TBA where id > 5"_s,
     u"Select id from TBA where id > 5 ORDER BY \"TBA\"._rowid_"_s},
    {"InsertionOrderOfJoin", u"SELECT x.id FROM tbA AS x LEFT JOIN tbB ON x.id = tbB.id"_s,
     u"SELECT x.id FROM tbA AS x LEFT JOIN tbB ON x.id = tbB.id ORDER BY \"x\"._rowid_"_s},
    {"ViewHasNoInsertionOrder", u"SELECT * FROM vwA WHERE id = 1"_s},
};

TEST(Translator, KeepsItsRules) {
    SmallSchema schema;
    for (const Rule& rule : Rules)
        EXPECT_EQ(ado::translate(ado::Statement(rule.before), schema, false), rule.after)
            << rule.name;
}

}  // namespace
