// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/dialect/Edits.h"
#include "platform/ado/dialect/Translator.h"

namespace ado {

/// A table of a FROM or JOIN: its name, and the name by which columns are qualified.
struct Source {
    QString table;
    QString alias;
};

/// A column as it is written: maybe a qualifier, and a name.
struct ColumnName {
    QString qualifier;
    QString name;
};

/// The translation of one statement: rules that act on its tokens and note edits of its text.
/// Values and sums are translated in StatementTranslator.cpp, orders in StatementOrder.cpp.
class Translation {
public:
    Translation(const Query& statement, Schema& schema, Dialect dialect)
        : s(statement), schema_(schema), isServer_(dialect == Dialect::Postgres) {
        survey();
    }

    /// The statement in the engine's dialect.
    QString run(bool withIdentity);

private:
    /// Calls `term(first, behind)` for each of the terms that commas part, from token `first` on to
    /// token `end`.
    template <class Term>
    void eachTerm(int first, int end, const Term& term) const {
        int depth = 0;
        for (int i = first; i <= end; ++i) {
            if (s.is(i, QLatin1StringView("("))) ++depth;
            if (s.is(i, QLatin1StringView(")"))) --depth;
            if (i != end && (depth != 0 || !s.is(i, QLatin1StringView(",")))) continue;
            term(first, i);
            first = i + 1;
        }
    }

    void survey();
    void noteSource(int i);
    void noteClause(int i);
    bool aggregates(int i) const;
    bool isKeyword(int i) const;
    bool touchesNumber(int i) const;

    void refuseServerFunctions() const;
    void literals();
    QString quoted(const QString& name) const;
    void convert(int i);
    void joins();
    int operandBefore(int plus) const;
    int operandBehind(int plus) const;
    void amountSums();
    void amountItems();
    void amountItem(int first, int behind);
    bool sumsMoney(int open, int behind);
    void floatSums();
    bool sumsSingles(int open, int behind);
    void numbersBesideTexts();
    void orders();
    void orderTerms();
    void orderTerm(int first, int behind);
    void orderNulls(int first, int behind);
    bool isIdentity(const ColumnName& column);
    QString orderOfUnion() const;
    QString orderOfGroups();
    QString orderOfInsertion();
    bool isOrderedByIdentity();

    ColumnName columnAt(int i) const;
    int columnEnd(int i) const;
    std::optional<ColumnType> typeOf(const ColumnName& column);
    bool isText(int first, int behind);
    int selectItem(int behind) const;
    int itemOf(const QString& alias, int& behind) const;
    QString aliasOf(const ColumnName& column) const;

    const Query& s;
    Schema& schema_;
    Edits edits_;
    bool isServer_;  ///< for PostgreSQL
    std::vector<Source> sources_;
    std::size_t outer_ = 0;  ///< the first SELECT's first source
    int from_ = -1;          ///< FROM of the first SELECT
    int group_ = -1;         ///< GROUP of the whole statement
    int order_ = -1;         ///< ORDER of the whole statement
    int limit_ = -1;
    bool grouped_ = false;  ///< GROUP BY, DISTINCT or an aggregate: rows are no rows of a table
    bool compound_ = false;
    bool keepsEqualRows_ = false;  ///< UNION ALL
    struct {
        bool arithmetic = false, plus = false, sum = false, literal = false;
    } has_;
};

}  // namespace ado
