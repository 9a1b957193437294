// SPDX-License-Identifier: MIT
#include "platform/forms/ListMatch.h"

#include <algorithm>
#include <string>

#include "platform/core/Folding.h"

namespace forms {

namespace {

std::string withoutBlanks(std::string text) {
    text.erase(std::remove(text.begin(), text.end(), ' '), text.end());
    return text;
}

/// What was typed, in the forms in which it is looked for.
struct Typed {
    explicit Typed(const QString& text)
        : plain(text), words(core::foldedWords(text)), run(withoutBlanks(words)) {}
    QString plain;
    std::string words;  ///< each word behind a blank
    std::string run;    ///< the same without blanks
};

constexpr int Ranks = 5;

/// 0 for the best fit; Ranks for none.
int rank(const QString& entry, const Typed& typed) {
    if (entry == typed.plain) return 0;
    if (typed.run.empty()) return Ranks;
    const std::string words = core::foldedWords(entry);
    if (words == typed.words) return 1;
    if (withoutBlanks(words).starts_with(typed.run)) return 2;
    if (words.find(typed.words) != std::string::npos) return 3;
    return words.find(typed.words.substr(1)) != std::string::npos ? 4 : Ranks;
}

}  // namespace

QList<qsizetype> matching(const QStringList& entries, const QString& typed) {
    const Typed sought(typed);
    QList<qsizetype> found[Ranks];
    for (qsizetype at = 0; at < entries.size(); ++at)
        if (const int how = rank(entries[at], sought); how < Ranks) found[how].append(at);
    QList<qsizetype> all;
    for (const QList<qsizetype>& positions : found) all.append(positions);
    return all;
}

}  // namespace forms
