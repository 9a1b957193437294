// SPDX-License-Identifier: MIT
#include "platform/ado/dialect/Translation.h"

#include <QDateTime>

#include "platform/ado/dialect/Translation.h"
#include "platform/ado/engine/ColumnValue.h"
#include "platform/core/Failure.h"

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

template <class Words>
bool isAny(const Query& s, int i, const Words& words) {
    return std::any_of(std::begin(words), std::end(words),
                       [&](QLatin1StringView word) { return s.is(i, word); });
}

}  // namespace

QString Translation::run(bool withIdentity) {
    refuse();
    if (has_.literal) literals();
    if (has_.plus) joins();
    if (has_.sum) sums();
    if (has_.arithmetic) amounts();
    comparisons();
    orders();
    if (withIdentity) edits_.insert(s.token(1).at, schema_.identity(sources_.front().table) + u',');
    if (s.end() < s.text().size()) edits_.replace(s.end(), s.text().size() - s.end(), {});
    return edits_.applied(s.text());
}

// One walk that finds what there is to do, so that a plain query costs nothing more.
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
            const bool allColumns = s.is(i - 1, "select"_L1) || s.is(i - 1, "."_L1);
            if (c == u'-' || (c == u'*' && !allColumns)) has_.arithmetic = true;
        } else if (token.kind == TokenKind::Word) {
            if (s.is(i, "select"_L1) && inner == 0) inner = depth;
            if (inner == 0 && from_ < 0 && aggregates(i)) grouped_ = true;
            if (depth == 0 && from_ < 0 && s.is(i, "from"_L1)) outer_ = sources_.size();
            if (s.is(i, "from"_L1) || s.is(i, "join"_L1)) noteSource(i);
            if (s.is(i, "sum"_L1)) has_.sum = true;
            if (s.is(i, "convert"_L1) || s.is(i - 1, "."_L1) || touchesNumber(i))
                has_.literal = true;
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
    if (s.is(i, "group"_L1)) group_ = i;
    if (s.is(i, "union"_L1) || s.is(i, "except"_L1) || s.is(i, "intersect"_L1)) compound_ = true;
    if (s.is(i, "all"_L1)) keepsEqualRows_ = true;
    if (s.is(i, "group"_L1) || s.is(i, "distinct"_L1)) grouped_ = true;
}

bool Translation::aggregates(int i) const {
    return s.is(i + 1, "("_L1) && (s.is(i, "sum"_L1) || s.is(i, "count"_L1) || s.is(i, "min"_L1) ||
                                   s.is(i, "max"_L1) || s.is(i, "avg"_L1) || s.is(i, "total"_L1));
}

bool Translation::isKeyword(int i) const {
    return isAny(s, i, Keywords);
}

/// True for a word directly behind a number.
bool Translation::touchesNumber(int i) const {
    if (i < 1 || s.kind(i - 1) != TokenKind::Number) return false;
    return s.token(i - 1).at + s.token(i - 1).length == s.token(i).at;
}

void Translation::noteSource(int i) {
    ++i;
    while (s.is(i, "("_L1)) ++i;
    if (!s.isWord(i) && (i >= s.count() || s.kind(i) != TokenKind::Name)) return;
    Source source{s.name(i), s.name(i)};
    if (s.is(i + 1, "as"_L1))
        source.alias = s.name(i + 2);
    else if (s.isWord(i + 1) && !isAny(s, i + 1, BehindSource))
        source.alias = s.name(i + 1);
    sources_.push_back(source);
}

void Translation::literals() {
    for (int i = 0; i < s.count(); ++i) {
        const Token& token = s.token(i);
        if (token.kind == TokenKind::Date) {
            const QDateTime moment = parseMoment(s.word(i).mid(1, token.length - 2));
            if (moment.isValid())
                edits_.replace(token.at, token.length, u"'%1'"_s.arg(storedForm(moment)));
        } else if (token.kind == TokenKind::DoubleText) {
            edits_.replace(token.at, token.length,
                           u"'%1'"_s.arg(s.name(i).replace(u"'"_s, u"''"_s)));
        } else if (token.kind == TokenKind::Name) {
            name(i);
        } else if (token.kind == TokenKind::Word && s.is(i, "convert"_L1)) {
            convert(i);
        } else if (token.kind == TokenKind::Word && s.is(i - 1, "."_L1)) {
            if (isKeyword(i)) edits_.replace(token.at, token.length, quoted(s.name(i)));
        } else if (token.kind == TokenKind::Word && touchesNumber(i) && isKeyword(i)) {
            edits_.insert(token.at, u" "_s);
        }
    }
}

QString Translation::quoted(const QString& name) const {
    return u'"' + QString(name).replace(u"\""_s, u"\"\""_s) + u'"';
}

void Translation::name(int i) {
    edits_.replace(s.token(i).at, s.token(i).length, quoted(s.name(i)));
}

QString Translation::orderOfNulls(bool descends) const {
    return descends ? u" NULLS LAST"_s : u" NULLS FIRST"_s;
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

}  // namespace ado
