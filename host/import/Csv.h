// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QStringList>
#include <vector>

namespace importing {

/// A line of a file, and which: the first is 1.
struct CsvRow {
    int line = 0;
    QStringList cells;
};

/// A text of rows: the names of the columns, and what stands below them.
struct CsvText {
    QStringList head;
    std::vector<CsvRow> rows;
};

/// Reads what spreadsheets write: UTF-8, or Windows-1252 where it is not UTF-8; cells parted by
/// ";", "," or tabs, whichever the first line has most of; texts in quotes, which may hold line
/// ends; lines that end in any way. Blanks around a cell and lines without any text do not count.
/// Fails with a core::Failure that names the line: no text at all, a quote that is never closed, an
/// encoding that is neither.
CsvText readCsv(const QByteArray& bytes);

}  // namespace importing
