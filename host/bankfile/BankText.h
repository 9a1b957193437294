// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace bankfile {

/// A text in the letters that every bank takes (a-z A-Z 0-9 / - ? : ( ) . , ' + and the blank), cut
/// to so many. Accents go; a letter that has no likeness among them becomes a point. Neither does
/// it begin or end with "/" nor hold "//", which have a meaning of their own between banks.
QString bankText(const QString& text, qsizetype most);

}  // namespace bankfile
