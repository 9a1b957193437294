// SPDX-License-Identifier: MIT
#include "platform/core/Folding.h"

#include <algorithm>

namespace core {

namespace {

/// Letters apart from their accents. Plain texts, the most common, are that already.
QString decomposed(const QString& text) {
    const auto isPlain = [](QChar letter) { return letter.unicode() < 128; };
    if (std::all_of(text.begin(), text.end(), isPlain)) return text;
    return text.normalized(QString::NormalizationForm_KD);
}

}  // namespace

std::string folded(const QString& text) {
    QString plain;
    plain.reserve(text.size());
    for (const QChar letter : decomposed(text))
        if (!letter.isMark()) plain += letter.toCaseFolded();
    return plain.toStdString();
}

std::string foldedWords(const QString& text) {
    QString plain;
    plain.reserve(text.size() + 1);
    bool between = true;
    for (const QChar letter : decomposed(text)) {
        if (letter.isMark()) continue;
        const bool part = letter.isLetterOrNumber() || letter.isSurrogate();
        if (part && between) plain += u' ';
        if (part) plain += letter.toCaseFolded();
        between = !part;
    }
    return plain.toStdString();
}

}  // namespace core
