// SPDX-License-Identifier: MIT
// Each rule of the translator is a row of rules.txt; what no rule knows stays as it is.
#include <gtest/gtest.h>

#include <QHash>

#include "platform/ado/dialect/Translator.h"
#include "tests/support/Failure.h"
#include "tests/support/Lines.h"

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

/// A rule of the list: four lines, its name, the statement as authors write it, for SQLite, for
/// PostgreSQL.
struct Rule {
    QString name, before, sqlite, postgresql;
};

QList<Rule> rules() {
    QList<Rule> all;
    const QStringList lines = support::linesOf(QStringLiteral(RULES_FILE));
    for (qsizetype at = 0; at + 3 < lines.size(); at += 4)
        all << Rule{lines[at], lines[at + 1], lines[at + 2], lines[at + 3]};
    return all;
}

class Translator : public testing::TestWithParam<Rule> {};

TEST_P(Translator, Keeps) {
    const Rule& rule = GetParam();
    for (const auto& [dialect, after] : {std::pair(ado::Dialect::Sqlite, rule.sqlite),
                                         {ado::Dialect::Postgres, rule.postgresql}}) {
        SmallSchema schema(dialect);
        EXPECT_EQ(ado::translate(ado::Query(rule.before), schema, false, dialect), after);
    }
}

INSTANTIATE_TEST_SUITE_P(Rule, Translator, testing::ValuesIn(rules()),
                         [](const auto& rule) { return rule.param.name.toStdString(); });

TEST(Statement, IsReadWithItsIdentityBeforeTheColumns) {
    const ado::Query statement(u"select * from tbB where id=1;"_s);
    SmallSchema file(ado::Dialect::Sqlite);
    EXPECT_EQ(ado::translate(statement, file, true),
              u"select _rowid_,* from tbB where id=1 ORDER BY \"tbB\"._rowid_"_s);
    SmallSchema server(ado::Dialect::Postgres);
    EXPECT_EQ(ado::translate(statement, server, true, ado::Dialect::Postgres),
              u"select _linha,* from tbB where id=1 ORDER BY \"tbb\"._linha"_s);
}

}  // namespace
