// SPDX-License-Identifier: MIT
// Each rule of the translator is a row of rules.txt; what no rule knows stays as it is.
#include <gtest/gtest.h>

#include <QHash>

#include "platform/ado/postgres/Dialect.h"
#include "platform/ado/sqlite/Dialect.h"
#include "tests/support/Failure.h"
#include "tests/support/Lines.h"

using namespace Qt::StringLiterals;

namespace {

/// tbA has a key of its own, tbB an identity that the server generates, vwA is a view of tbA.
class SmallSchema : public ado::Schema {
public:
    explicit SmallSchema(bool isServer) : isServer_(isServer) {}
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
        if (!isTable(table)) return {};
        if (!isServer_) return QString::fromLatin1(ado::sqlite::Identity);
        return table.endsWith(u'A') ? u"id"_s : u"_linha"_s;
    }

private:
    bool isServer_;
};

/// A rule of the list: four lines, its name, the query as authors write it, for SQLite, for
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
    const ado::Query query(rule.before);
    SmallSchema file(false);
    EXPECT_EQ(ado::sqlite::translate(query, file, false), rule.sqlite);
    SmallSchema server(true);
    EXPECT_EQ(ado::postgres::translate(query, server, false), rule.postgresql);
}

INSTANTIATE_TEST_SUITE_P(Rule, Translator, testing::ValuesIn(rules()),
                         [](const auto& rule) { return rule.param.name.toStdString(); });

TEST(Query, IsReadWithItsIdentityBeforeTheColumns) {
    const ado::Query query(u"select * from tbB where id=1;"_s);
    SmallSchema file(false);
    EXPECT_EQ(ado::sqlite::translate(query, file, true),
              u"select _rowid_,* from tbB where id=1 ORDER BY \"tbB\"._rowid_"_s);
    SmallSchema server(true);
    EXPECT_EQ(ado::postgres::translate(query, server, true),
              u"select _linha,* from tbB where id=1 ORDER BY \"tbb\"._linha"_s);
}

}  // namespace
