// SPDX-License-Identifier: MIT
#pragma once

#include <optional>

#include "platform/ado/dialect/Edits.h"
#include "platform/ado/dialect/Query.h"
#include "platform/ado/engine/Session.h"

namespace ado {

/// What the translator asks about the book.
class Schema {
public:
    virtual ~Schema() = default;
    /// True for an existing table whose rows have an identity; false for a view.
    virtual bool isTable(QStringView name) = 0;
    /// The declared type of a column of a table or view; nothing when there is no such column.
    virtual std::optional<ColumnType> columnType(QStringView table, QStringView column) = 0;
    /// The column that is a table's row identity; empty for anything but a table.
    virtual QString identity(QStringView table) = 0;
};

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

/// The translation of one query into the language of an engine: rules that act on its tokens and
/// note edits of its text. What no rule knows is passed on as it stands. Here stands what engines
/// have in common; what one of them does in another way it overrides.
class Translation {
public:
    Translation(const Query& query, Schema& schema) : s(query), schema_(schema) { survey(); }
    virtual ~Translation() = default;

    /// The query in the engine's language. With `withIdentity` (only for a `SELECT *` over one
    /// table) the row identity stands before the columns.
    QString run(bool withIdentity);

protected:
    /// Fails where the query reaches for more than tables and plain functions.
    virtual void refuse() const {}
    /// A name in quotes.
    virtual QString quoted(const QString& name) const;
    /// The token is a name in brackets or quotes.
    virtual void name(int i);
    /// There are sums, or there is other arithmetic, which may want to be exact.
    virtual void sums() {}
    virtual void amounts() {}
    /// Columns may be compared with values of another type.
    virtual void comparisons() {}
    /// What stands behind a text in an order, so that texts sort as a Portuguese reader expects.
    virtual QString orderOfTexts() const { return {}; }
    /// What stands behind a value in an order, so that nulls come before all values.
    virtual QString orderOfNulls(bool descends) const;
    /// Whether the rows of joins in brackets can be ordered by the identity of the first table.
    virtual bool seesIdentityInBrackets() const { return true; }

    const Query& s;
    Edits edits_;

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

    ColumnName columnAt(int i) const;
    /// The token behind the column that begins at a token.
    int columnEnd(int i) const;
    /// The declared type; nothing when no source has such a column.
    std::optional<ColumnType> typeOf(const ColumnName& column);

private:
    void survey();
    void noteSource(int i);
    void noteClause(int i);
    bool aggregates(int i) const;
    bool isKeyword(int i) const;
    bool touchesNumber(int i) const;

    void literals();
    void convert(int i);
    void joins();
    int operandBefore(int plus) const;
    int operandBehind(int plus) const;
    void orders();
    void orderTerms();
    bool orderTerm(int first, int behind);
    bool orderNulls(int first, int behind);
    bool isIdentity(const ColumnName& column);
    QString orderOfUnion() const;
    QString orderOfGroups();
    QString orderOfInsertion();
    bool isOrderedByIdentity();

    bool isText(int first, int behind);
    int selectItem(int behind) const;
    int itemOf(const QString& alias, int& behind) const;
    QString aliasOf(const ColumnName& column) const;

    Schema& schema_;
    std::vector<Source> sources_;
    std::size_t outer_ = 0;  ///< the first SELECT's first source
    int from_ = -1;          ///< FROM of the first SELECT
    int group_ = -1;         ///< GROUP of the whole query
    int order_ = -1;         ///< ORDER of the whole query
    int limit_ = -1;
    bool grouped_ = false;  ///< GROUP BY, DISTINCT or an aggregate: rows are no rows of a table
    bool compound_ = false;
    bool keepsEqualRows_ = false;  ///< UNION ALL
    struct {
        bool arithmetic = false, plus = false, sum = false, literal = false;
    } has_;
};

}  // namespace ado
