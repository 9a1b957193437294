// SPDX-License-Identifier: MIT
#include "platform/core/Folding.h"

#include <optional>
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

/// The letters of one or two bytes that become one other, by their code: the long way for them is
/// gone once.
const std::vector<std::optional<Letter>>& commonLetters() {
    static const std::vector<std::optional<Letter>> common = [] {
        std::vector<std::optional<Letter>> letters(0x250);
        for (uint code = 0; code < letters.size(); ++code)
            if (const auto plain = plainLetters(QChar(code)); plain.size() == 1)
                letters[code] = plain.front();
        return letters;
    }();
    return common;
}

/// The letter that begins at a byte, which moves behind it; null when it is none of the common.
const Letter* commonLetter(std::string_view utf8, std::size_t& at) {
    uint code = static_cast<unsigned char>(utf8[at++]);
    if (code >= 0x80) {
        if ((code & 0xE0U) != 0xC0U || at == utf8.size()) return nullptr;
        code = (code & 0x1FU) << 6 | (static_cast<unsigned char>(utf8[at++]) & 0x3FU);
    }
    const auto& common = commonLetters();
    return code < common.size() && common[code] ? &*common[code] : nullptr;
}

bool isCommon(std::string_view utf8) {
    for (std::size_t at = 0; at < utf8.size();)
        if (!commonLetter(utf8, at)) return false;
    return true;
}

template <class Take>
void eachPlain(std::string_view utf8, const Take& take) {
    if (isCommon(utf8)) {
        for (std::size_t at = 0; at < utf8.size();) take(*commonLetter(utf8, at));
        return;
    }
    for (const Letter& letter :
         plainLetters(QString::fromUtf8(utf8.data(), qsizetype(utf8.size()))))
        take(letter);
}

}  // namespace

std::string folded(std::string_view utf8) {
    std::string plain;
    plain.reserve(utf8.size());
    eachPlain(utf8, [&](const Letter& letter) { plain += letter.utf8; });
    return plain;
}

std::string foldedWords(std::string_view utf8) {
    std::string words;
    words.reserve(utf8.size() + 1);
    bool isBetween = true;
    eachPlain(utf8, [&](const Letter& letter) {
        if (letter.isWord && isBetween) words += ' ';
        if (letter.isWord) words += letter.utf8;
        isBetween = !letter.isWord;
    });
    return words;
}

}  // namespace core
