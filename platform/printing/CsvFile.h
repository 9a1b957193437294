// SPDX-License-Identifier: MIT
#pragma once

#include <QSaveFile>
#include <QStringList>
#include <QVariant>

namespace printing {

/// Rows as a text that spreadsheets open: semicolons, decimal comma, texts in quotes, UTF-8 with a
/// mark. A text that a spreadsheet would run as a formula, or read as a date or as a number with
/// fewer digits, gets a leading apostrophe. Only its owner can read the file, and it is there when
/// it is whole. Failures are core::Failure with a Portuguese text.
class CsvFile {
public:
    explicit CsvFile(const QString& name);
    void heading(const QStringList& names);
    /// Null is an empty cell.
    void line(const QVariantList& values);
    /// Puts the file in its place, over one that is there.
    void close();

private:
    void write(const QStringList& cells);
    QSaveFile file_;
};

}  // namespace printing
