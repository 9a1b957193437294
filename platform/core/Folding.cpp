// SPDX-License-Identifier: MIT
#include "platform/core/Folding.h"

#include <array>
#include <vector>

namespace core {

namespace {

/// What a letter becomes, and whether it is part of a word.
struct Letter {
    std::string utf8;
    bool isWord = false;
};

/// The letters of a text apart from their accents, and the accents gone.
std::vector<Letter> plainLetters(const QString& text) {
    QString plain;
    for (const QChar letter : text.normalized(QString::NormalizationForm_KD))
        if (!letter.isMark()) plain += letter.toCaseFolded();
    std::vector<Letter> letters;
    for (const char32_t letter : plain.toUcs4())
        letters.push_back({QString::fromUcs4(&letter, 1).toStdString(),
                           letter > 0xFFFF || QChar::isLetterOrNumber(letter)});
    return letters;
}

/// A letter of one or two bytes that becomes one other, which is no longer.
struct CommonLetter {
    char utf8[2] = {};
    unsigned char size = 0;  ///< of what it becomes; 0 for a letter that goes the long way
    bool isWord = false;
};

/// By their code: names consist of little else, and a large book has millions of them.
using CommonLetters = std::array<CommonLetter, 0x250>;

const CommonLetters& commonLetters() {
    static const CommonLetters common = [] {
        CommonLetters letters{};
        for (uint code = 0; code < letters.size(); ++code) {
            const std::vector<Letter> plain = plainLetters(QChar(code));
            const std::size_t own = code < 0x80 ? 1 : 2;
            if (plain.size() != 1 || plain.front().utf8.size() > own) continue;
            CommonLetter& letter = letters[code];
            letter.size = static_cast<unsigned char>(plain.front().utf8.copy(letter.utf8, own));
            letter.isWord = plain.front().isWord;
        }
        return letters;
    }();
    return common;
}

/// Gives the letters of a text to a function one by one, folded. False, with a part of them given,
/// when one is none of the common.
template <class Take>
bool eachCommon(std::string_view utf8, const Take& take) {
    const CommonLetters& common = commonLetters();
    for (std::size_t at = 0; at < utf8.size();) {
        uint code = static_cast<unsigned char>(utf8[at++]);
        if (code >= 0x80) {
            if ((code & 0xE0U) != 0xC0U || at == utf8.size()) return false;
            code = (code & 0x1FU) << 6 | (static_cast<unsigned char>(utf8[at++]) & 0x3FU);
        }
        if (code >= common.size() || common[code].size == 0) return false;
        const CommonLetter& letter = common[code];
        take(std::string_view(letter.utf8, letter.size), letter.isWord);
    }
    return true;
}

/// The same for every text, after `start`, which may be called twice.
template <class Start, class Take>
void eachPlain(std::string_view utf8, const Start& start, const Take& take) {
    start();
    if (eachCommon(utf8, take)) return;
    start();
    for (const Letter& letter :
         plainLetters(QString::fromUtf8(utf8.data(), qsizetype(utf8.size()))))
        take(letter.utf8, letter.isWord);
}

}  // namespace

std::string folded(std::string_view utf8) {
    std::string plain;
    plain.reserve(utf8.size());
    eachPlain(
        utf8, [&] { plain.clear(); }, [&](std::string_view letter, bool) { plain += letter; });
    return plain;
}

void appendFoldedWords(std::string& words, std::string_view utf8) {
    const std::size_t before = words.size();
    bool isBetween = true;
    eachPlain(
        utf8,
        [&] {
            words.resize(before);
            isBetween = true;
        },
        [&](std::string_view letter, bool isWord) {
            if (isWord && isBetween) words += ' ';
            if (isWord) words += letter;
            isBetween = !isWord;
        });
}

std::string foldedWords(std::string_view utf8) {
    std::string words;
    words.reserve(utf8.size() + 1);
    appendFoldedWords(words, utf8);
    return words;
}

}  // namespace core
