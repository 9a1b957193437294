// SPDX-License-Identifier: MIT
#pragma once

#include <QStringView>

/// Code values of the book, each in one place.
namespace data {

/// `tipo` of a movement.
namespace tipo {
inline constexpr QStringView Document = u"DOC";
inline constexpr QStringView Hospital = u"HOS";
inline constexpr QStringView Receipt = u"PAG";
inline constexpr QStringView Reposition = u"REP";
inline constexpr QStringView Annulled = u"ANL";    ///< keeps the amounts it had
inline constexpr QStringView Correcting = u"COR";  ///< stands beside an annulled movement
}  // namespace tipo

/// `modo_pagamento` of a movement.
namespace modo {
inline constexpr QStringView Cheque = u"CHQ";
inline constexpr QStringView Transfer = u"TRF";
inline constexpr QStringView Annulled = u"ANL";
/// The longest entry of the list, as the screens show it.
inline constexpr QStringView Widest = u"VEN - Desconto no vencimento";
}  // namespace modo

/// `ficheiro` of a movement in force; any other value means the tables of those who have left.
namespace ficheiro {
inline constexpr QStringView Active = u"ACTIVO";
}  // namespace ficheiro

/// `codABC`: who a document is for.
namespace person {
/// The member himself.
inline constexpr QStringView Member = u"A";
/// A code that contains this letter, in either case, is a child's.
inline constexpr QStringView ChildLetter = u"C";
}  // namespace person

/// Characters of a valid bank account identifier (`nib`).
inline constexpr int NibLength = 21;

}  // namespace data
