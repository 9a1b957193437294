// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

/// Numbers of accounts, proved by their check digits (remainder 1 of a division by 97).
namespace bankfile {

/// Digits of a national bank number.
inline constexpr qsizetype NibLength = 21;

/// True for 21 digits, and nothing else, whose last two prove the others.
bool isNib(const QString& text);
/// True for an international number without blanks whose check digits are right; of Portugal's the
/// national number in it must be right as well.
bool isIban(const QString& text);
/// The international number of a right national one.
QString ibanOf(const QString& nib);

/// An account as a person types it, national or international, with or without blanks: the
/// international number, or an empty text when it is none.
QString ibanTyped(const QString& text);
/// True for a bank's code of 8 or 11 letters and digits.
bool isBic(const QString& text);

}  // namespace bankfile
