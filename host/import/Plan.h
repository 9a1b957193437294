// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "host/import/Csv.h"
#include "host/import/Kinds.h"
#include "platform/ado/engine/BulkAccess.h"

namespace importing {

/// What becomes of a row of a file.
enum class Outcome { New, Changed, Same, Refused };

/// "novo", "alterado", "igual", "recusado"
QString outcomeText(Outcome outcome);

/// A row of a file and what would become of it.
struct PlannedRow {
    int line = 0;
    Outcome outcome = Outcome::Refused;
    QString key;               ///< who or what it is about, as the file names it
    QString detail;            ///< name of what is new; changes, field by field; why it is refused
    qint64 storedKey = 0;      ///< of Changed: of the row in the book
    ado::BulkRow values = {};  ///< of New and Changed: beside the plan's columns
    QString group = {};        ///< of a new rubric: the code of its group, when that is new as well
};

/// What a file would do to a book.
struct Plan {
    const Description* description = nullptr;
    std::vector<Column> columns;  ///< those of the file, in its order
    std::vector<PlannedRow> rows;

    qsizetype count(Outcome outcome) const;
    /// True when something would be written.
    bool hasWork() const { return count(Outcome::New) + count(Outcome::Changed) > 0; }
    /// "1.000 novos, 12 alterados, 3 iguais, 50 recusados"
    QString summary() const;
};

/// Told how many of the file's rows are done; false gives up.
using GoesOn = std::function<bool(qsizetype done, qsizetype of)>;

/// Holds a file against a book, reading it only. Columns that the file does not have stay as they
/// are; an empty cell empties the column. A row is refused, with all its reasons, for a cell that
/// cannot be read or is missing, for a member or group that there is not, for a key that came
/// before or that several rows of the book have. Fails with a core::Failure for a column that
/// nobody knows, that comes twice, or that is missing. Empty of rows when given up.
Plan planOf(const CsvText& csv, Kind kind, ado::BulkAccess& book, const GoesOn& goesOn);

}  // namespace importing
