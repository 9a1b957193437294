// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <string>

namespace core {

// How people compare texts while they type: without accents and without case. UTF-8.

/// The letters of a text, folded; everything else as it stands.
std::string folded(const QString& text);

/// The words of a text, folded, each behind one blank, so that " ana" finds the beginning of a word
/// only. Everything but letters and digits parts words.
std::string foldedWords(const QString& text);

}  // namespace core
