// SPDX-License-Identifier: MIT
#include "platform/ado/dialect/Translation.h"

namespace ado {

using namespace Qt::StringLiterals;

void Translation::orderTerms() {
    bool plain = true;
    eachTerm(order_ + 2, limit_ > order_ ? limit_ : s.count(),
             [&](int first, int behind) { plain = orderTerm(first, behind) && plain; });
    // The engine takes an order of its own kind behind a UNION of groups only from around it; a
    // plain one stays behind it, where the rows are compared and sorted in one go.
    if (!compound_ || plain) return;
    edits_.insert(s.token(0).at, u"SELECT * FROM ("_s);
    edits_.insert(s.token(order_).at, u") AS uniao "_s);
}

/// True for a column alone that stays ordered as the query has it.
bool Translation::orderTerm(int first, int behind) {
    bool plain = first < behind && !orderNulls(first, behind);
    if (s.is(behind - 1, "asc"_L1) || s.is(behind - 1, "desc"_L1)) --behind;
    if (first >= behind || !s.isWord(first) || columnEnd(first) != behind) return false;
    const ColumnName column = columnAt(first);
    const Token& name = s.token(behind - 1);
    const qsizetype end = name.at + name.length;
    // Behind a UNION only the columns of the result have names.
    if (compound_ && !column.qualifier.isEmpty())
        edits_.replace(s.token(first).at, end - s.token(first).at, aliasOf(column));
    if (const QString order = orderOfTexts(); !order.isEmpty() && isText(first, behind)) {
        edits_.insert(end, order);
        plain = false;
    }
    return plain;
}

// Nulls come before all values. A table's identity has none and is found in its order as it is.
// False when the term has to say nothing of them.
bool Translation::orderNulls(int first, int behind) {
    const bool descends = s.is(behind - 1, "desc"_L1);
    const QString order = orderOfNulls(descends);
    if (order.isEmpty()) return false;
    const int end = descends || s.is(behind - 1, "asc"_L1) ? behind - 1 : behind;
    if (s.isWord(first) && columnEnd(first) == end && isIdentity(columnAt(first))) return false;
    const Token& last = s.token(behind - 1);
    edits_.insert(last.at + last.length, order);
    return true;
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

/// A union without equal rows is sorted by its columns, all of them if they are listed.
QString Translation::orderOfUnion() const {
    if (keepsEqualRows_) return {};
    QStringList positions;
    bool listed = true;
    eachTerm(1, from_, [&](int, int behind) {
        if (s.is(behind - 1, "*"_L1)) listed = false;
        positions << QString::number(positions.size() + 1) + orderOfNulls(false);
    });
    if (!listed) return {};
    return positions.join(u',');
}

/// Groups stand in the order of what they are grouped by.
QString Translation::orderOfGroups() {
    int end = group_ + 2;
    while (end < s.count() && !s.is(end, "having"_L1) && !s.is(end, "order"_L1) && end != limit_)
        ++end;
    QStringList terms;
    eachTerm(group_ + 2, end, [&](int first, int behind) {
        if (!s.isWord(first) || columnEnd(first) != behind || isKeyword(behind - 1)) return;
        const Token& last = s.token(behind - 1);
        QString term = s.text().mid(s.token(first).at, last.at + last.length - s.token(first).at);
        if (const QString order = orderOfTexts(); !order.isEmpty() && isText(first, behind))
            term += order;
        terms << term + orderOfNulls(false);
    });
    return terms.join(u',');
}

/// Rows of a table stand in the order of their insertion, whatever index finds them.
QString Translation::orderOfInsertion() {
    if (grouped_ || from_ < 0 || outer_ >= sources_.size()) return {};
    const Source& first = sources_[outer_];
    if (s.is(from_ + 1, "("_L1) && !seesIdentityInBrackets()) return {};
    const QString identity = schema_.identity(first.table);
    if (identity.isEmpty() || isOrderedByIdentity()) return {};
    return quoted(first.alias) + u'.' + identity;
}

bool Translation::isOrderedByIdentity() {
    bool found = false;
    if (order_ >= 0)
        eachTerm(order_ + 2, s.count(), [&](int first, int behind) {
            if (s.is(behind - 1, "asc"_L1) || s.is(behind - 1, "desc"_L1)) --behind;
            if (s.isWord(first) && columnEnd(first) == behind && isIdentity(columnAt(first)))
                found = true;
        });
    return found;
}

// What a query leaves open is settled, so that both engines give the rows in one order: rows
// that are equal in its own order, and all rows where it has none.
void Translation::orders() {
    if (order_ >= 0) orderTerms();
    const QString settled = compound_     ? orderOfUnion()
                            : group_ >= 0 ? orderOfGroups()
                                          : orderOfInsertion();
    if (settled.isEmpty()) return;
    edits_.insert(limit_ < 0 ? s.end() : s.token(limit_).at - 1,
                  (order_ >= 0 ? u", "_s : u" ORDER BY "_s) + settled);
}

}  // namespace ado
