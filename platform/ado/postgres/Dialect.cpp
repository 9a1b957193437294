// SPDX-License-Identifier: MIT
#include "platform/ado/postgres/Dialect.h"

#include "platform/core/Failure.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;

namespace {

class Dialect final : public Translation {
public:
    using Translation::Translation;

private:
    void refuse() const override;
    /// The names of the book are in small letters.
    QString quoted(const QString& name) const override {
        return Translation::quoted(name.toLower());
    }
    void sums() override;
    void comparisons() override;

    bool sumsSingles(int open, int behind);
};

// What a server has besides tables and plain functions waits, locks, stops others, reads files.
void Dialect::refuse() const {
    for (int i = 0; i < s.count(); ++i) {
        QStringView name = s.word(i);
        if (s.kind(i) == TokenKind::Name) name = name.mid(1);
        if (name.startsWith("pg_"_L1, Qt::CaseInsensitive))
            throw core::Failure(
                core::InvalidCall,
                u"A consulta usa «%1», que é do servidor, e não foi executada."_s.arg(s.name(i)));
    }
}

// The server would sum 32-bit floats into one of their kind, and digits would go with every row.
void Dialect::sums() {
    for (int i = 0; i < s.count(); ++i) {
        if (!s.is(i, "sum"_L1) || !s.is(i + 1, "("_L1)) continue;
        const int behind = s.behindBracket(i + 1);
        if (!sumsSingles(i + 1, behind)) continue;
        edits_.insert(s.token(i + 1).at + 1, u"CAST("_s);
        edits_.insert(s.token(behind - 1).at, u" AS double precision)"_s);
    }
}

bool Dialect::sumsSingles(int open, int behind) {
    for (int i = open + 1; i < behind - 1; ++i) {
        if (!s.isWord(i)) continue;
        if (typeOf(columnAt(i)) == ColumnType::Single) return true;
        i = columnEnd(i) - 1;
    }
    return false;
}

// The server compares a text with texts only; people also write staff numbers bare.
void Dialect::comparisons() {
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

}  // namespace

QString translate(const Query& query, Schema& schema, bool withIdentity) {
    return Dialect(query, schema).run(withIdentity);
}

}  // namespace ado::postgres
