// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>

#include "platform/ado/Recordset.h"

namespace forms {

/// The value that a text typed by a person stands for in a column of that type; an empty text is
/// null everywhere but in a text column. Fails with TypeMismatch and a text that quotes what was
/// typed and says what is wrong with it.
QVariant fromTypedText(const QString& text, ado::ColumnType type);

/// The day's first instant; null for an empty text. Fails as above.
QVariant fromTypedDate(const QString& text);

}  // namespace forms
