// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Dialect.h"

namespace ado::sqlite {

using namespace Qt::StringLiterals;

namespace {

class Dialect final : public Translation {
public:
    using Translation::Translation;

private:
    /// Intentional: a name in brackets stays as it is, for one in quotes that no table has would be
    /// taken for a text.
    void name(int) override {}
    void sums() override;
    void amounts() override;
    QString orderOfTexts() const override { return u" COLLATE "_s + QLatin1StringView(Collation); }
    /// Nulls come first by themselves.
    QString orderOfNulls(bool) const override { return {}; }
    /// Brackets hide it; the first of the joins is passed through in its order all the same.
    bool seesIdentityInBrackets() const override { return false; }

    void amountItem(int first, int behind);
    bool sumsMoney(int open, int behind);
};

// Amounts are stored in binary; a sum of them, and a sum of such sums, is brought back to the
// four decimals that the amounts have, so that 0.4 - 0.3 is not above 0.1.
void Dialect::sums() {
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

// The same for what is worked out of amounts by itself. A product has the decimals of its factors.
void Dialect::amounts() {
    for (int i = 0; i < s.count(); ++i) {
        if (!s.is(i, "select"_L1)) continue;
        int depth = 0;
        int from = i + 1;
        for (; from < s.count() && (depth > 0 || !s.is(from, "from"_L1)); ++from) {
            if (s.is(from, "("_L1)) ++depth;
            if (s.is(from, ")"_L1)) --depth;
        }
        eachTerm(i + 1, from, [&](int first, int behind) {
            if (s.is(behind - 2, "as"_L1)) behind -= 2;
            amountItem(first, behind);
        });
    }
}

void Dialect::amountItem(int first, int behind) {
    bool money = false;
    bool worked = false;
    qsizetype decimals = 4;
    for (int i = first; i < behind; ++i) {
        if (s.isWord(i)) {
            if (typeOf(columnAt(i)) != ColumnType::Money) return;
            money = true;
            i = columnEnd(i) - 1;
        } else if (s.kind(i) == TokenKind::Number) {
            const qsizetype point = s.word(i).indexOf(u'.');
            if (point >= 0) decimals += s.word(i).size() - point - 1;
        } else if (s.is(i, "+"_L1) || s.is(i, "-"_L1) || s.is(i, "*"_L1)) {
            worked = true;
        } else if (!s.is(i, "("_L1) && !s.is(i, ")"_L1)) {
            return;
        }
    }
    if (!money || !worked) return;
    const Token& last = s.token(behind - 1);
    edits_.insert(s.token(first).at, u"ROUND("_s);
    edits_.insert(last.at + last.length, u",%1)"_s.arg(decimals));
}

/// True when amounts are among the columns between the brackets and no other kind of number.
bool Dialect::sumsMoney(int open, int behind) {
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

}  // namespace

QString translate(const Query& query, Schema& schema, bool withIdentity) {
    return Dialect(query, schema).run(withIdentity);
}

}  // namespace ado::sqlite
