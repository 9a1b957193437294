// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QVarLengthArray>

namespace ado {

enum class TokenKind : quint8 {
    Word,  ///< a name or a keyword
    Number,
    Text,        ///< between single quotes, a quote inside doubled
    DoubleText,  ///< between double quotes
    Name,        ///< between brackets or backquotes
    Date,        ///< between # signs
    Symbol,      ///< one character of anything else
};

struct Token {
    TokenKind kind;
    qsizetype at;
    qsizetype length;
};

/// A query's text, cut into tokens once. Blanks and comments stand between tokens. Makes a
/// Failure of a quote or a comment that nobody closes, and of a null character.
class Query {
public:
    explicit Query(const QString& text);

    const QString& text() const { return text_; }
    /// Number of tokens, a closing ";" not counted.
    int count() const { return static_cast<int>(tokens_.size()); }
    const Token& token(int i) const { return tokens_[i]; }
    /// The token's text as it stands, quotes included; empty past the ends.
    QStringView word(int i) const;
    /// True when the token is that word or symbol, without regard to case. `word` in lower case.
    bool is(int i, QLatin1StringView word) const;
    bool isWord(int i) const { return i >= 0 && i < count() && kind(i) == TokenKind::Word; }
    TokenKind kind(int i) const { return tokens_[i].kind; }
    /// The name that a word, bracketed or quoted token stands for.
    QString name(int i) const;
    /// Token behind the bracket that token `open` opens; count() when it is never closed.
    int behindBracket(int open) const;
    /// Where the text of the last token ends.
    qsizetype end() const;

    /// Refuses what is no single query before it reaches an engine; `shapes` lets SHAPE through.
    void requireQuery(bool shapes) const;
    /// The table of a `SELECT * FROM table …` over one table; empty for anything else.
    QString singleTable() const;
    /// True when it groups its rows.
    bool groups() const;

private:
    void tokenize();
    void push(TokenKind kind, qsizetype at, qsizetype end) { tokens_.append({kind, at, end - at}); }
    bool isMarkedText(int i) const;
    qsizetype quoted(qsizetype at, QChar close) const;
    bool endsAt(qsizetype at) const;

    QString text_;
    QVarLengthArray<Token, 96> tokens_;
    bool hasComment_ = false;
};

}  // namespace ado
