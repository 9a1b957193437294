// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace tiqueta {

/// Digits of a bank account identifier.
inline constexpr int NibLength = 21;

/// The identifier as it is kept: without the blanks, points and hyphens that people group it with,
/// and without the country prefix of a Portuguese international number ("PT50").
QString compactNib(const QString& typed);

/// True for 21 digits, the last two being right: the whole number leaves 1 when divided by 97
/// (ISO 7064, MOD 97-10).
bool isValidNib(const QString& nib);

/// What the operator should know of a number while typing it; empty for an empty one.
QString nibHint(const QString& typed);

}  // namespace tiqueta
