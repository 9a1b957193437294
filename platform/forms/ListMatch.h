// SPDX-License-Identifier: MIT
#pragma once

#include <QList>
#include <QStringList>

namespace forms {

/// Positions of the entries that a typed text fits, the likeliest first: the entry that reads just
/// so; those that begin so; those with a word that begins so; those that hold it inside a word.
/// Accents, case and the marks between letters and digits do not count: "502" finds "5.02". A text
/// without a letter or digit fits nothing.
QList<qsizetype> matching(const QStringList& entries, const QString& typed);

}  // namespace forms
