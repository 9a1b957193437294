// SPDX-License-Identifier: MIT
#include "platform/ado/StatementTranslator.h"

#include <QDateTime>

#include "platform/ado/ColumnValue.h"
#include "platform/ado/Edits.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

/// Words that no engine takes as a column's name behind a dot.
constexpr QLatin1StringView Keywords[] = {
    "all"_L1,     "and"_L1,         "as"_L1,     "between"_L1,  "case"_L1,   "check"_L1,
    "create"_L1,  "default"_L1,     "delete"_L1, "distinct"_L1, "drop"_L1,   "else"_L1,
    "exists"_L1,  "from"_L1,        "group"_L1,  "having"_L1,   "in"_L1,     "index"_L1,
    "insert"_L1,  "into"_L1,        "is"_L1,     "isnull"_L1,   "join"_L1,   "limit"_L1,
    "not"_L1,     "notnull"_L1,     "null"_L1,   "on"_L1,       "or"_L1,     "order"_L1,
    "primary"_L1, "references"_L1,  "select"_L1, "set"_L1,      "table"_L1,  "then"_L1,
    "to"_L1,      "transaction"_L1, "union"_L1,  "unique"_L1,   "update"_L1, "using"_L1,
    "values"_L1,  "when"_L1,        "where"_L1};

/// Words that may follow a table and are no alias of it.
constexpr QLatin1StringView BehindSource[] = {
    "where"_L1, "left"_L1,  "inner"_L1,   "join"_L1,      "on"_L1,      "order"_L1,  "group"_L1,
    "union"_L1, "right"_L1, "full"_L1,    "cross"_L1,     "limit"_L1,   "having"_L1, "except"_L1,
    "using"_L1, "outer"_L1, "natural"_L1, "intersect"_L1, "indexed"_L1, "not"_L1};

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

class Translation {
public:
    Translation(const Statement& statement, Schema& schema, Dialect dialect)
        : s(statement), schema_(schema), isServer_(dialect == Dialect::Postgres) {
        survey();
    }

    QString run(bool withIdentity) {
        literals();
        if (has_.plus) joins();
        if (has_.sum) isServer_ ? floatSums() : amountSums();
        if (isServer_) numbersBesideTexts();
        if (order_ >= 0) orderTerms();
        insertionOrder();
        if (withIdentity)
            edits_.insert(s.token(1).at, schema_.identity(sources_.front().table) + u',');
        if (s.end() < s.text().size()) edits_.replace(s.end(), s.text().size() - s.end(), {});
        return edits_.applied(s.text());
    }

private:
    template <class Words>
    bool isAny(int i, const Words& words) const {
        return std::any_of(std::begin(words), std::end(words),
                           [&](QLatin1StringView word) { return s.is(i, word); });
    }

    void survey();
    void noteSource(int i);
    void noteClause(int i);
    bool aggregates(int i) const;

    void literals();
    QString quoted(const QString& name) const;
    void convert(int i);
    void joins();
    int operandBefore(int plus) const;
    int operandBehind(int plus) const;
    void amountSums();
    bool sumsMoney(int open, int behind);
    void floatSums();
    bool sumsSingles(int open, int behind);
    void numbersBesideTexts();
    void orderTerms();
    void orderTerm(int first, int behind);
    void orderNulls(int first, int behind);
    bool isIdentity(const ColumnName& column);
    void insertionOrder();

    ColumnName columnAt(int i) const;
    int columnEnd(int i) const;
    std::optional<ColumnType> typeOf(const ColumnName& column);
    bool isText(int first, int behind);
    int selectItem(int behind) const;
    int itemOf(const QString& alias, int& behind) const;
    QString aliasOf(const ColumnName& column) const;

    const Statement& s;
    Schema& schema_;
    Edits edits_;
    bool isServer_;  ///< for PostgreSQL
    std::vector<Source> sources_;
    std::size_t outer_ = 0;  ///< the first SELECT's first source
    int from_ = -1;          ///< FROM of the first SELECT
    int order_ = -1;         ///< ORDER of the whole statement
    int limit_ = -1;
    bool grouped_ = false;  ///< GROUP BY, DISTINCT or an aggregate: rows are no rows of a table
    bool compound_ = false;
    struct {
        bool plus = false, sum = false, literal = false;
    } has_;
};

// One walk that finds what there is to do, so that a plain statement costs nothing more.
void Translation::survey() {
    int depth = 0;
    int inner = 0;  // depth of the outermost SELECT in brackets; 0 outside of one
    for (int i = 0; i < s.count(); ++i) {
        const Token& token = s.token(i);
        if (token.kind == TokenKind::Symbol) {
            const QChar c = s.text()[token.at];
            if (c == u'(') ++depth;
            if (c == u')' && --depth < inner) inner = 0;
            if (c == u'+') has_.plus = true;
        } else if (token.kind == TokenKind::Word) {
            if (s.is(i, "select"_L1) && inner == 0) inner = depth;
            if (inner == 0 && from_ < 0 && aggregates(i)) grouped_ = true;
            if (depth == 0 && from_ < 0 && s.is(i, "from"_L1)) outer_ = sources_.size();
            if (s.is(i, "from"_L1) || s.is(i, "join"_L1)) noteSource(i);
            if (s.is(i, "sum"_L1)) has_.sum = true;
            if (s.is(i, "convert"_L1) || s.is(i - 1, "."_L1)) has_.literal = true;
            if (depth == 0) noteClause(i);
        } else if (token.kind == TokenKind::Date || token.kind == TokenKind::DoubleText ||
                   token.kind == TokenKind::Name) {
            has_.literal = true;
        }
    }
}

void Translation::noteClause(int i) {
    if (s.is(i, "from"_L1) && from_ < 0) from_ = i;
    if (s.is(i, "order"_L1) && s.is(i + 1, "by"_L1)) order_ = i;
    if (s.is(i, "limit"_L1)) limit_ = i;
    if (s.is(i, "union"_L1) || s.is(i, "except"_L1) || s.is(i, "intersect"_L1)) compound_ = true;
    if (s.is(i, "group"_L1) || s.is(i, "distinct"_L1)) grouped_ = true;
}

bool Translation::aggregates(int i) const {
    return s.is(i + 1, "("_L1) && (s.is(i, "sum"_L1) || s.is(i, "count"_L1) || s.is(i, "min"_L1) ||
                                   s.is(i, "max"_L1) || s.is(i, "avg"_L1) || s.is(i, "total"_L1));
}

void Translation::noteSource(int i) {
    ++i;
    while (s.is(i, "("_L1)) ++i;
    if (!s.isWord(i) && (i >= s.count() || s.kind(i) != TokenKind::Name)) return;
    Source source{s.name(i), s.name(i)};
    if (s.is(i + 1, "as"_L1))
        source.alias = s.name(i + 2);
    else if (s.isWord(i + 1) && !isAny(i + 1, BehindSource))
        source.alias = s.name(i + 1);
    sources_.push_back(source);
}

void Translation::literals() {
    if (!has_.literal) return;
    for (int i = 0; i < s.count(); ++i) {
        const Token& token = s.token(i);
        if (token.kind == TokenKind::Date) {
            const QDateTime moment = parseMoment(s.word(i).mid(1, token.length - 2));
            if (moment.isValid())
                edits_.replace(token.at, token.length, u"'%1'"_s.arg(storedForm(moment)));
        } else if (token.kind == TokenKind::DoubleText) {
            edits_.replace(token.at, token.length,
                           u"'%1'"_s.arg(s.name(i).replace(u"'"_s, u"''"_s)));
        } else if (token.kind == TokenKind::Name && isServer_) {
            edits_.replace(token.at, token.length, quoted(s.name(i)));
        } else if (token.kind == TokenKind::Word && s.is(i, "convert"_L1)) {
            convert(i);
        } else if (token.kind == TokenKind::Word && s.is(i - 1, "."_L1)) {
            if (isAny(i, Keywords)) edits_.replace(token.at, token.length, quoted(s.name(i)));
        }
    }
}

/// A name in quotes; the server's unquoted names are lower case.
QString Translation::quoted(const QString& name) const {
    return u"\"%1\""_s.arg(isServer_ ? name.toLower() : name);
}

// CONVERT(DATETIME, 'text'[, style]): whatever the style says, the text is month/day/year.
void Translation::convert(int i) {
    const int behind = s.behindBracket(i + 1);
    const bool form = s.is(i + 1, "("_L1) && s.is(i + 2, "datetime"_L1) && s.is(i + 3, ","_L1) &&
                      i + 4 < s.count() && s.kind(i + 4) == TokenKind::Text &&
                      (behind == i + 6 || (behind == i + 8 && s.is(i + 5, ","_L1)));
    if (!form) return;
    const QDateTime moment = parseMoment(QStringView(s.name(i + 4)).trimmed());
    if (!moment.isValid()) return;
    const qsizetype at = s.token(i).at;
    const Token& last = s.token(behind - 1);
    edits_.replace(at, last.at + last.length - at, u"'%1'"_s.arg(storedForm(moment)));
}

/// First token of the operand that ends before the sign.
int Translation::operandBefore(int plus) const {
    int i = plus - 1;
    if (s.is(i, ")"_L1)) {
        int depth = 0;
        for (; i >= 0; --i) {
            if (s.is(i, ")"_L1)) ++depth;
            if (s.is(i, "("_L1) && --depth == 0) break;
        }
        if (s.isWord(i - 1)) --i;
        return i;
    }
    while (s.is(i - 1, "."_L1)) i -= 2;
    return i;
}

/// Token behind the operand that begins behind the sign.
int Translation::operandBehind(int plus) const {
    int i = plus + 1;
    if (s.isWord(i) && s.is(i + 1, "("_L1)) ++i;
    if (s.is(i, "("_L1)) return s.behindBracket(i);
    while (s.is(i + 1, "."_L1)) i += 2;
    return i + 1;
}

// A + joins texts when a text stands beside it, or when it belongs to a chain with such a +.
void Translation::joins() {
    const auto isText = [&](int i) {
        return i >= 0 && i < s.count() &&
               (s.kind(i) == TokenKind::Text || s.kind(i) == TokenKind::DoubleText);
    };
    std::vector<int> open;
    std::vector<int> joining;
    for (int i = 1; i < s.count(); ++i)
        if (s.is(i, "+"_L1)) (isText(i - 1) || isText(i + 1) ? joining : open).push_back(i);
    const auto isJoining = [&](int i) {
        return std::find(joining.begin(), joining.end(), i) != joining.end();
    };
    for (bool again = true; again;) {
        const auto chained = std::partition(open.begin(), open.end(), [&](int plus) {
            return !isJoining(operandBefore(plus) - 1) && !isJoining(operandBehind(plus));
        });
        again = chained != open.end();
        joining.insert(joining.end(), chained, open.end());
        open.erase(chained, open.end());
    }
    for (const int plus : joining) edits_.replace(s.token(plus).at, 1, u"||"_s);
}

// SQLite stores amounts in binary; a sum of them, and a sum of such sums, is brought back to the
// four decimals that the amounts have, so that 0.4 - 0.3 is not above 0.1.
void Translation::amountSums() {
    for (int i = 0; i < s.count(); ++i) {
        if (!s.is(i, "sum"_L1) || !s.is(i + 1, "("_L1)) continue;
        int behind = s.behindBracket(i + 1);
        bool money = sumsMoney(i + 1, behind);
        while ((s.is(behind, "-"_L1) || s.is(behind, "+"_L1)) && s.is(behind + 1, "sum"_L1) &&
               s.is(behind + 2, "("_L1)) {
            const int open = behind + 2;
            behind = s.behindBracket(open);
            money = sumsMoney(open, behind) && money;
        }
        if (money) {
            const Token& last = s.token(behind - 1);
            edits_.insert(s.token(i).at, u"ROUND("_s);
            edits_.insert(last.at + last.length, u",4)"_s);
        }
        i = behind - 1;
    }
}

/// True when amounts are among the columns between the brackets and no other kind of number.
bool Translation::sumsMoney(int open, int behind) {
    bool money = false;
    for (int i = open + 1; i < behind - 1; ++i) {
        if (!s.isWord(i)) continue;
        const auto type = typeOf(columnAt(i));
        i = columnEnd(i) - 1;
        if (type == ColumnType::Single || type == ColumnType::Double) return false;
        money = money || type == ColumnType::Money;
    }
    return money;
}

// The server would sum 32-bit floats into one of their kind, and digits would go with every row.
void Translation::floatSums() {
    for (int i = 0; i < s.count(); ++i) {
        if (!s.is(i, "sum"_L1) || !s.is(i + 1, "("_L1)) continue;
        const int behind = s.behindBracket(i + 1);
        if (!sumsSingles(i + 1, behind)) continue;
        edits_.insert(s.token(i + 1).at + 1, u"CAST("_s);
        edits_.insert(s.token(behind - 1).at, u" AS double precision)"_s);
    }
}

bool Translation::sumsSingles(int open, int behind) {
    for (int i = open + 1; i < behind - 1; ++i) {
        if (!s.isWord(i)) continue;
        if (typeOf(columnAt(i)) == ColumnType::Single) return true;
        i = columnEnd(i) - 1;
    }
    return false;
}

// The server compares a text with texts only; people also write staff numbers bare.
void Translation::numbersBesideTexts() {
    for (int i = 2; i < s.count(); ++i) {
        if (s.kind(i) != TokenKind::Number) continue;
        int before = i - 1;
        while (s.is(before, "="_L1) || s.is(before, "<"_L1) || s.is(before, ">"_L1)) --before;
        if (before == i - 1 || before < 0 || !s.isWord(before)) continue;
        const int column = s.is(before - 1, "."_L1) ? before - 2 : before;
        if (typeOf(columnAt(column)) == ColumnType::Text)
            edits_.replace(s.token(i).at, s.token(i).length, u"'%1'"_s.arg(s.word(i)));
    }
}

ColumnName Translation::columnAt(int i) const {
    if (s.is(i + 1, "."_L1)) return {s.name(i), s.name(i + 2)};
    return {{}, s.name(i)};
}

int Translation::columnEnd(int i) const {
    return s.is(i + 1, "."_L1) ? i + 3 : i + 1;
}

std::optional<ColumnType> Translation::typeOf(const ColumnName& column) {
    for (const Source& source : sources_) {
        if (!column.qualifier.isEmpty() &&
            column.qualifier.compare(source.alias, Qt::CaseInsensitive) != 0)
            continue;
        if (const auto type = schema_.columnType(source.table, column.name)) return type;
    }
    return std::nullopt;
}

void Translation::orderTerms() {
    // The engine takes an order of its own kind behind a UNION of groups only from around it.
    if (compound_) {
        edits_.insert(s.token(0).at, u"SELECT * FROM ("_s);
        edits_.insert(s.token(order_).at, isServer_ ? u") AS uniao "_s : u") "_s);
    }
    const int end = limit_ > order_ ? limit_ : s.count();
    int depth = 0;
    int first = order_ + 2;
    for (int i = first; i <= end; ++i) {
        if (s.is(i, "("_L1)) ++depth;
        if (s.is(i, ")"_L1)) --depth;
        if (i == end || (depth == 0 && s.is(i, ","_L1))) {
            orderTerm(first, i);
            first = i + 1;
        }
    }
}

void Translation::orderTerm(int first, int behind) {
    if (isServer_ && first < behind) orderNulls(first, behind);
    if (s.is(behind - 1, "asc"_L1) || s.is(behind - 1, "desc"_L1)) --behind;
    if (first >= behind || !s.isWord(first) || columnEnd(first) != behind) return;
    const ColumnName column = columnAt(first);
    const Token& name = s.token(behind - 1);
    const qsizetype end = name.at + name.length;
    // Behind a UNION only the columns of the result have names.
    if (compound_ && !column.qualifier.isEmpty())
        edits_.replace(s.token(first).at, end - s.token(first).at, aliasOf(column));
    if (!isServer_ && isText(first, behind))
        edits_.insert(end, u" COLLATE "_s + QLatin1StringView(Collation));
}

// Nulls come before all values. A table's identity has none and is found in its order as it is.
void Translation::orderNulls(int first, int behind) {
    const bool descends = s.is(behind - 1, "desc"_L1);
    const int end = descends || s.is(behind - 1, "asc"_L1) ? behind - 1 : behind;
    if (s.isWord(first) && columnEnd(first) == end && isIdentity(columnAt(first))) return;
    const Token& last = s.token(behind - 1);
    edits_.insert(last.at + last.length, descends ? u" NULLS LAST"_s : u" NULLS FIRST"_s);
}

bool Translation::isIdentity(const ColumnName& column) {
    if (sources_.size() != 1) return false;
    return schema_.identity(sources_.front().table).compare(column.name, Qt::CaseInsensitive) == 0;
}

/// True for a column that the book declares as text, and for a joined text of the SELECT list.
bool Translation::isText(int first, int behind) {
    const ColumnName column = columnAt(first);
    if (const auto type = typeOf(column)) return *type == ColumnType::Text;
    if (!column.qualifier.isEmpty()) return false;
    int itemEnd = behind;
    const int item = itemOf(column.name, itemEnd);
    if (item < 0) return false;
    if (s.isWord(item) && columnEnd(item) == itemEnd)
        return typeOf(columnAt(item)) == ColumnType::Text;
    for (int i = item; i < itemEnd; ++i)
        if (s.is(i, "+"_L1) &&
            (s.kind(i - 1) == TokenKind::Text || s.kind(i + 1) == TokenKind::Text))
            return true;
    return false;
}

/// Where the SELECT item begins that ends before `behind`.
int Translation::selectItem(int behind) const {
    int depth = 0;
    int i = behind - 1;
    for (; i > 0; --i) {
        if (s.is(i, ")"_L1)) ++depth;
        if (s.is(i, "("_L1)) --depth;
        if (depth == 0 && s.is(i, ","_L1)) break;
    }
    return i + 1;
}

/// First token of the SELECT item with that alias, and the token behind it; -1 when there is none.
int Translation::itemOf(const QString& alias, int& behind) const {
    for (int i = 2; i < from_; ++i) {
        if (!s.is(i - 1, "as"_L1) || s.name(i).compare(alias, Qt::CaseInsensitive) != 0) continue;
        behind = i - 1;
        return selectItem(behind);
    }
    return -1;
}

/// The result's name of a column of the first SELECT.
QString Translation::aliasOf(const ColumnName& column) const {
    for (int i = 1; i + 4 < from_; ++i) {
        if (!s.isWord(i) || !s.is(i + 1, "."_L1) || !s.is(i + 3, "as"_L1)) continue;
        const ColumnName item = columnAt(i);
        if (item.qualifier.compare(column.qualifier, Qt::CaseInsensitive) == 0 &&
            item.name.compare(column.name, Qt::CaseInsensitive) == 0)
            return s.word(i + 4).toString();
    }
    return column.name;
}

// Without an order of its own a read of a table gives the rows in the order of their insertion,
// whatever index finds them.
void Translation::insertionOrder() {
    if (order_ >= 0 || compound_ || grouped_ || from_ < 0 || outer_ >= sources_.size()) return;
    const Source& first = sources_[outer_];
    // SQLite passes through the first of joins in brackets as it does without them.
    if (!isServer_ && s.is(from_ + 1, "("_L1)) return;
    const QString identity = schema_.identity(first.table);
    if (identity.isEmpty()) return;
    const QString order = u" ORDER BY %1.%2"_s.arg(quoted(first.alias), identity);
    edits_.insert(limit_ < 0 ? s.end() : s.token(limit_).at - 1, order);
}

}  // namespace

QString translate(const Statement& statement, Schema& schema, bool withIdentity, Dialect dialect) {
    return Translation(statement, schema, dialect).run(withIdentity);
}

}  // namespace ado
