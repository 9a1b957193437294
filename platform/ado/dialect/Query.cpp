// SPDX-License-Identifier: MIT
#include "platform/ado/dialect/Query.h"

#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

[[noreturn]] void refuse(const QString& text) {
    throw core::Failure(core::InvalidCall, text);
}

bool isDigit(QChar c) {
    return c >= u'0' && c <= u'9';
}

bool startsWord(QChar c) {
    const char16_t u = c.unicode();
    return (u >= u'a' && u <= u'z') || (u >= u'A' && u <= u'Z') || u == u'_' || u >= 0x80;
}

bool continuesWord(QChar c) {
    return startsWord(c) || isDigit(c) || c == u'$';
}

}  // namespace

Query::Query(const QString& text) : text_(text) {
    if (text_.contains(QChar(u'\0')))
        refuse(u"A consulta tem um carácter nulo e não foi executada."_s);
    tokenize();
    while (!tokens_.isEmpty() && text_[tokens_.last().at] == u';') tokens_.removeLast();
}

qsizetype Query::quoted(qsizetype at, QChar close) const {
    for (qsizetype i = at + 1; i < text_.size(); ++i) {
        if (text_[i] != close) continue;
        const bool doubled = close != u']' && i + 1 < text_.size() && text_[i + 1] == close;
        if (!doubled) return i + 1;
        ++i;
    }
    refuse(u"A consulta tem uma aspa por fechar e não foi executada: %1"_s.arg(text_.mid(at, 40)));
}

void Query::tokenize() {
    const qsizetype size = text_.size();
    const QChar* text = text_.constData();
    for (qsizetype at = 0; at < size;) {
        const QChar c = text[at];
        const QChar next = at + 1 < size ? text[at + 1] : QChar();
        qsizetype end = at + 1;
        if (c == u' ' || (c >= u'\t' && c <= u'\r')) {
            at = end;
            continue;
        }
        if (startsWord(c)) {
            while (end < size && continuesWord(text[end])) ++end;
            push(TokenKind::Word, at, end);
        } else if (isDigit(c) || (c == u'.' && isDigit(next) && !endsAt(at))) {
            while (end < size && (isDigit(text[end]) || text[end] == u'.')) ++end;
            push(TokenKind::Number, at, end);
        } else if (c == u'\'' || c == u'"') {
            end = quoted(at, c);
            push(c == u'"' ? TokenKind::DoubleText : TokenKind::Text, at, end);
        } else if (c == u'[' || c == u'`') {
            end = quoted(at, c == u'[' ? u']' : u'`');
            push(TokenKind::Name, at, end);
        } else if (c == u'-' && next == u'-') {
            while (end < size && text[end] != u'\n') ++end;
            hasComment_ = true;
        } else if (c == u'/' && next == u'*') {
            end = text_.indexOf(u"*/"_s, at + 2) + 2;
            if (end < at + 2) refuse(u"A consulta tem um comentário por fechar."_s);
            hasComment_ = true;
        } else {
            while (c == u'#' && end < size && (isDigit(text[end]) || text[end] == u'/')) ++end;
            const bool date = end > at + 1 && end < size && text[end] == u'#';
            if (!date) end = at + 1;
            push(date ? TokenKind::Date : TokenKind::Symbol, at, date ? end + 1 : end);
            if (date) ++end;
        }
        at = end;
    }
}

/// True when a name or a number ends there, so that a point behind it parts names.
bool Query::endsAt(qsizetype at) const {
    if (tokens_.isEmpty()) return false;
    const Token& last = tokens_.last();
    return last.at + last.length == at && last.kind != TokenKind::Symbol;
}

QStringView Query::word(int i) const {
    if (i < 0 || i >= count()) return {};
    return QStringView(text_).mid(tokens_[i].at, tokens_[i].length);
}

bool Query::is(int i, QLatin1StringView word) const {
    if (i < 0 || i >= count() || tokens_[i].length != word.size()) return false;
    const QChar* c = text_.constData() + tokens_[i].at;
    for (const char w : word) {
        const char16_t u = c++->unicode();
        if ((u >= u'A' && u <= u'Z' ? u + 32 : u) != static_cast<char16_t>(w)) return false;
    }
    return true;
}

QString Query::name(int i) const {
    QStringView text = word(i);
    if (text.isEmpty() || kind(i) == TokenKind::Word || text.size() < 2) return text.toString();
    const QChar close = text.back();
    QString inner = text.mid(1, text.size() - 2).toString();
    return close == u']' ? inner : inner.replace(QString(2, close), QString(close));
}

int Query::behindBracket(int open) const {
    int depth = 0;
    for (int i = open; i < count(); ++i) {
        if (kind(i) != TokenKind::Symbol) continue;
        const QChar c = text_[tokens_[i].at];
        if (c == u'(' || c == u'{') ++depth;
        if ((c == u')' || c == u'}') && --depth == 0) return i + 1;
    }
    return count();
}

qsizetype Query::end() const {
    return tokens_.isEmpty() ? 0 : tokens_.last().at + tokens_.last().length;
}

void Query::requireQuery(bool shapes) const {
    if (!is(0, "select"_L1) && !(shapes && is(0, "shape"_L1)))
        refuse(u"Só são aceites consultas (SELECT); não foi executado: %1"_s.arg(text_.left(80)));
    // No query of the system has one; typed in, it would hide the rest of a query.
    if (hasComment_)
        refuse(
            u"Uma consulta não pode ter comentários; não foi executado: %1"_s.arg(text_.left(80)));
    for (int i = 1; i < count(); ++i) {
        const auto refuseFrom = [&](const QString& why) {
            refuse(why + u"; não foi executado: "_s + text_.mid(tokens_[i].at, 80));
        };
        if (is(i, ";"_L1)) refuseFrom(u"Só é aceite uma consulta de cada vez"_s);
        if (is(i, "$"_L1) || isMarkedText(i))
            refuseFrom(u"Uma consulta não pode ter «$» nem uma letra colada a um texto"_s);
        // An engine takes them for parameters, which nobody would fill.
        if (is(i, "?"_L1) || is(i, ":"_L1) || is(i, "@"_L1))
            refuseFrom(u"Uma consulta não pode ter «?», «:» nem «@» fora de um texto"_s);
    }
}

// $$…$$, E'…' and U&'…' end elsewhere for a server than for the tokens.
bool Query::isMarkedText(int i) const {
    if (kind(i) != TokenKind::Text && kind(i) != TokenKind::DoubleText) return false;
    const Token& before = tokens_[i - 1];
    return before.at + before.length == tokens_[i].at && (isWord(i - 1) || is(i - 1, "&"_L1));
}

bool Query::groups() const {
    for (int i = 0; i < count(); ++i)
        if (is(i, "group"_L1)) return true;
    return false;
}

QString Query::singleTable() const {
    if (!is(0, "select"_L1) || !is(1, "*"_L1) || !is(2, "from"_L1)) return {};
    if (count() > 4 && !is(4, "where"_L1) && !is(4, "order"_L1)) return {};
    for (int i = 4; i < count(); ++i)
        if (is(i, "union"_L1) || is(i, "except"_L1) || is(i, "intersect"_L1) || is(i, "group"_L1))
            return {};
    if (count() < 4 || (kind(3) != TokenKind::Word && kind(3) != TokenKind::Name)) return {};
    return name(3);
}

}  // namespace ado
