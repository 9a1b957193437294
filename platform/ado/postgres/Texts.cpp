// SPDX-License-Identifier: MIT
#include "platform/ado/postgres/Texts.h"

#include <limits>

#include "platform/ado/dialect/Edits.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;

namespace {

/// Texts that are kept; more than these and all are made anew.
constexpr qsizetype KeptTexts = 256;

/// A parameter is of the type that the value itself would have, so that it compares alike.
constexpr auto WholeNumber = "::int4"_L1;

/// Numbers of other types than the parameter's have to stay where they are.
bool fits(const LiftedQuery& lifted) {
    for (const Cell& value : lifted.values) {
        if (value.kind == Cell::Real) return false;
        if (value.kind == Cell::Integer && value.integer > std::numeric_limits<qint32>::max())
            return false;
    }
    return true;
}

/// Statements with the same text but values of other kinds are others.
QString keyOf(const LiftedQuery& lifted, bool withIdentity) {
    QString key = withIdentity ? u"*"_s : u" "_s;
    for (const Cell& value : lifted.values) key += value.kind == Cell::Text ? u't' : u'n';
    return key + u' ' + lifted.text;
}

/// Names the places of the values as the server does.
QByteArray numbered(const QString& translated, const std::vector<Cell>& values) {
    const Query statement(translated);
    Edits edits;
    std::size_t number = 0;
    for (int i = 0; i < statement.count() && number < values.size(); ++i) {
        if (!statement.is(i, "?"_L1)) continue;
        const Cell& value = values[number++];
        QString mark = u'$' + QString::number(number);
        if (value.kind == Cell::Integer) mark += WholeNumber;
        edits.replace(statement.token(i).at, 1, mark);
    }
    return edits.applied(translated).toUtf8();
}

Values valuesOf(const LiftedQuery& lifted) {
    Values values;
    for (const Cell& value : lifted.values)
        values.push_back(
            value.kind == Cell::Integer
                ? QByteArray::number(value.integer)
                : QByteArray(value.text.data(), static_cast<qsizetype>(value.text.size())));
    return values;
}

}  // namespace

QByteArray Texts::whole(const Query& statement, bool withIdentity) {
    return translate(statement, schema_, withIdentity).toUtf8();
}

std::optional<Call> Texts::lifted(const Query& statement, bool withIdentity) {
    const auto lifted = LiftedQuery::from(statement);
    if (!lifted || !fits(*lifted)) return std::nullopt;
    const QString key = keyOf(*lifted, withIdentity);
    auto text = texts_.constFind(key);
    if (text == texts_.constEnd()) {
        if (texts_.size() >= KeptTexts) texts_.clear();
        const QString translated = translate(Query(lifted->text), schema_, withIdentity);
        text = texts_.insert(key, numbered(translated, lifted->values));
    }
    if (text->isEmpty()) return std::nullopt;
    return Call{*text, valuesOf(*lifted)};
}

void Texts::keepWhole(const Query& statement, bool withIdentity) {
    if (const auto lifted = LiftedQuery::from(statement))
        texts_.insert(keyOf(*lifted, withIdentity), {});
}

}  // namespace ado::postgres
