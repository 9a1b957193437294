// SPDX-License-Identifier: MIT
#include <QRegularExpression>
#include <algorithm>

#include "platform/core/Format.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"
#include "platform/printing/CsvFile.h"
#include "platform/printing/Output.h"
#include "platform/printing/SavedFile.h"
#include "platform/printing/Sections.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

/// The columns of a section in the order of its fields, each once.
QStringList columnsOf(const Section& section) {
    QStringList columns;
    for (const Item& item : section.items)
        if (const auto* field = std::get_if<Field>(&item);
            field && !columns.contains(field->column, Qt::CaseInsensitive))
            columns << field->column;
    return columns;
}

/// A text that a spreadsheet would run as a formula or read as a date or as a number that has lost
/// digits ("00123", a bank number, "1E5") is kept a text by a leading apostrophe, the one mark that
/// none of them runs or reads on. A number that stays as it is needs none.
QString harmless(const QString& text) {
    static const QRegularExpression risky(uR"(^[=+\-@\t\r]|^[\d.,][\d.,:/ Ee+\-]*$)"_s);
    static const QRegularExpression sameNumber(uR"(^-?(0|[1-9]\d{0,9})(,\d{0,3}[1-9])?$)"_s);
    return risky.match(text).hasMatch() && !sameNumber.match(text).hasMatch() ? u'\'' + text : text;
}

/// A text as a cell: always in quotes, so that no reader takes a sign in it for the cell's end.
QString quoted(const QString& text) {
    return u'"' + QString(text).replace(u'"', u"\"\""_s) + u'"';
}

/// An engine gives a computed column as a double, which lies a little beside the amount that is
/// meant.
QVariant asAmount(const QVariant& value) {
    if (value.typeId() != QMetaType::Double) return value;
    return QVariant::fromValue(core::Money::fromDouble(value.toDouble()));
}

QString cell(const QVariant& value) {
    if (value.typeId() != QMetaType::QString)
        return core::formatted(asAmount(value), {}, core::portugueseLocale());
    return quoted(harmless(value.toString()));
}

/// The columns of one row set.
class Cells {
public:
    Cells(const QStringList& names, ado::Recordset& rows) {
        for (const QString& name : names) values_.place(name);
        values_.lookUp(rows);
    }
    QVariantList of(const ado::Recordset& rows, qint64 row) {
        values_.read(rows, row);
        return QVariantList(values_.values().begin(), values_.values().end());
    }

private:
    RowValues values_;
};

void writeGroups(CsvFile& file, const Report& report, ado::Recordset& rows) {
    Cells group(columnsOf(report.groupHeader), rows);
    for (qint64 row = 0; row < rows.rowsInMemory(); ++row) {
        rows.MoveTo(row);
        const ado::RecordsetPtr children = rows.Chapter(report.chapter);
        const QVariantList head = group.of(rows, row);
        Cells detail(columnsOf(report.detail), *children);
        for (qint64 child = 0; child < children->rowsInMemory(); ++child)
            file.line(head + detail.of(*children, child));
    }
}

}  // namespace

CsvFile::CsvFile(const QString& name) : file_(name) {
    if (!openPrivately(file_)) failToWrite(file_);
    file_.write("\xEF\xBB\xBF");
}

void CsvFile::heading(const QStringList& names) {
    QStringList cells;
    for (const QString& name : names) cells << quoted(name);
    write(cells);
}

void CsvFile::line(const QVariantList& values) {
    QStringList cells;
    for (const QVariant& value : values) cells << cell(value);
    write(cells);
}

void CsvFile::write(const QStringList& cells) {
    file_.write(cells.join(u';').toUtf8() + "\r\n");
}

void CsvFile::close() {
    if (!file_.commit()) failToWrite(file_);
}

void writeCsv(const Report& report, const ado::RecordsetPtr& rows, const QString& file) {
    rows->readAll();
    CsvFile out(file);
    const QStringList columns = columnsOf(report.detail);
    if (!report.chapter.isEmpty()) {
        out.heading(columnsOf(report.groupHeader) + columns);
        writeGroups(out, report, *rows);
    } else {
        out.heading(columns);
        Cells detail(columns, *rows);
        for (qint64 row = 0; row < rows->rowsInMemory(); ++row) out.line(detail.of(*rows, row));
    }
    out.close();
}

}  // namespace printing
