// SPDX-License-Identifier: MIT
#include "platform/ado/dialect/LiftedQuery.h"

#include <charconv>

namespace ado {

using namespace Qt::StringLiterals;

namespace {

/// Digits of a number that surely fits 64 bits.
constexpr qsizetype LongestInteger = 18;

/// Words behind which values are conditions no longer.
bool endsConditions(const Query& s, int i) {
    return s.is(i, "group"_L1) || s.is(i, "order"_L1) || s.is(i, "union"_L1) ||
           s.is(i, "having"_L1) || s.is(i, "limit"_L1) || s.is(i, "select"_L1);
}

/// True when the token stands directly behind or before a word: 1e5, x'ab'.
bool touchesWord(const Query& s, int i) {
    const Token& token = s.token(i);
    const bool before = s.isWord(i - 1) && s.token(i - 1).at + s.token(i - 1).length == token.at;
    const bool behind = s.isWord(i + 1) && s.token(i + 1).at == token.at + token.length;
    return before || behind;
}

std::optional<Cell> number(QStringView text) {
    Cell cell;
    const QByteArray digits = text.toLatin1();
    if (digits.contains('.')) {
        cell.kind = Cell::Real;
        const auto read = std::from_chars(digits.begin(), digits.end(), cell.real);
        if (read.ec != std::errc() || read.ptr != digits.end()) return std::nullopt;
        return cell;
    }
    if (digits.size() > LongestInteger) return std::nullopt;
    cell.kind = Cell::Integer;
    std::from_chars(digits.begin(), digits.end(), cell.integer);
    return cell;
}

}  // namespace

std::optional<LiftedQuery> LiftedQuery::from(const Query& s) {
    LiftedQuery lifted;
    lifted.text.reserve(s.text().size());
    qsizetype from = 0;
    bool inConditions = false;
    for (int i = 0; i < s.count(); ++i) {
        const Token& token = s.token(i);
        std::optional<Cell> value;
        switch (token.kind) {
            case TokenKind::Date:
            case TokenKind::DoubleText:
                return std::nullopt;
            case TokenKind::Symbol:
                if (s.text()[token.at] == u'+' || s.text()[token.at] == u'?') return std::nullopt;
                break;
            case TokenKind::Word:
                if (s.is(i, "convert"_L1) || s.is(i, "like"_L1)) return std::nullopt;
                if (s.is(i, "where"_L1)) inConditions = true;
                if (endsConditions(s, i)) inConditions = false;
                break;
            case TokenKind::Number:
                if (inConditions && !touchesWord(s, i)) value = number(s.word(i));
                break;
            case TokenKind::Text:
                if (!inConditions || touchesWord(s, i)) break;
                lifted.texts.push_back(s.name(i).toUtf8());
                value = Cell{Cell::Text, 0, 0, {}};
                break;
            case TokenKind::Name:
                break;
        }
        if (!value) continue;
        lifted.values.push_back(*value);
        lifted.text += QStringView(s.text()).mid(from, token.at - from);
        lifted.text += u'?';
        from = token.at + token.length;
    }
    lifted.text += QStringView(s.text()).mid(from, s.end() - from);
    std::size_t next = 0;
    for (Cell& value : lifted.values)
        if (value.kind == Cell::Text) {
            const QByteArray& text = lifted.texts[next++];
            value.text = {text.constData(), static_cast<std::size_t>(text.size())};
        }
    return lifted;
}

}  // namespace ado
