// SPDX-License-Identifier: MIT
#pragma once

#include "host/import/Kinds.h"
#include "platform/ado/engine/BulkAccess.h"

namespace importing {

/// What a cell of a file comes to, or why it comes to nothing.
struct ReadCell {
    ado::BulkValue value = {};  ///< null for an empty cell
    QString fault = {};         ///< empty when there is none
};

/// Reads a cell; whole numbers of members and groups are found by others.
ReadCell readCell(const QString& text, Holds holds, int definedSize);

/// A value of the book, or of a file, as a preview shows it and as two of them are compared: an
/// empty text is the same as none.
QString shownValue(const ado::BulkValue& value, Holds holds);

}  // namespace importing
