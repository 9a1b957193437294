// SPDX-License-Identifier: MIT
#pragma once

#include <optional>

#include "database/Copy.h"
#include "host/import/Plan.h"

/// Members, relatives, premiums, rubrics and hospitals from files of other programs.
namespace importing {

/// What is brought in.
struct Wish {
    Kind kind = Kind::Members;
    QString file;
};

/// Reads a file and holds it against a book, which is only read. Nothing when given up. Fails as
/// readCsv() and planOf() do, and when the file or the book cannot be opened.
std::optional<Plan> preview(const Wish& wish, const database::BookPlace& place,
                            const GoesOn& goesOn);

enum class Refused { WriteNothing, LeaveOut };

/// Writes what a file brings, all of it or nothing: what was refused keeps all from being written
/// unless it is to be left out. The plan is made anew from the book as it stands then; where it is
/// no longer the one that was seen, nothing is written and it fails. Gives what was done, or what
/// would have been where nothing was written; nothing when given up. Fails as preview() does, and
/// when the book cannot be written, by whom it may not be among them; the book is then as before.
/// @param seen  the summary and rows that somebody agreed to; null for whoever wants whatever the
///              file says
struct Result {
    Plan plan;
    bool isWritten = false;
};
std::optional<Result> importFile(const Wish& wish, const database::BookPlace& place,
                                 Refused refused, const Plan* seen, const GoesOn& goesOn);

}  // namespace importing
