// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <string>
#include <string_view>

namespace core {

// How people compare texts while they type: without accents and without case. Texts are UTF-8.

/// The letters of a text, folded; everything else as it stands.
std::string folded(std::string_view utf8);
inline std::string folded(const QString& text) {
    return folded(std::string_view(text.toStdString()));
}

/// The words of a text, folded, each behind one blank, so that " ana" finds the beginning of a word
/// only. Everything but letters and digits parts words.
std::string foldedWords(std::string_view utf8);
/// The same, behind what `words` holds already.
void appendFoldedWords(std::string& words, std::string_view utf8);
inline std::string foldedWords(const QString& text) {
    return foldedWords(std::string_view(text.toStdString()));
}

}  // namespace core
