// SPDX-License-Identifier: MIT
#pragma once

#include "host/documents/MemberDocuments.h"

namespace documents {

/// Told how many of how many members have been looked at; false gives up.
using GoesOn = std::function<bool(qsizetype done, qsizetype all)>;

/// What came of it.
struct Made {
    qsizetype documents = 0;
    bool isWhole = true;  ///< false when given up
};

/// Writes a PDF a person into the folder, which is made where it is missing:
/// "100015-2026-carta.pdf" by staff number, year and kind. Never writes over a file: another one of
/// that name gets a number behind it. Those made before giving up or failing stay. Fails when one
/// cannot be written.
Made writeEach(const Wish& wish, const ado::ConnectionPtr& connection, const QString& folder,
               const GoesOn& goesOn = {});

/// Writes all into one PDF, each with pages of its own numbers. Never writes over a file. Without
/// any document, or when given up, nothing is written.
Made writeTogether(const Wish& wish, const ado::ConnectionPtr& connection, const QString& file,
                   const GoesOn& goesOn = {});

}  // namespace documents
