// SPDX-License-Identifier: MIT
#include "host/MovementOutput.h"

#include <QHash>
#include <algorithm>

#include "host/MovementList.h"
#include "platform/printing/CsvFile.h"
#include "reports/Furniture.h"

using namespace Qt::StringLiterals;

namespace host {

using namespace printing;
using reports::Column;

namespace {

/// Rows read with one query.
constexpr std::size_t Stretch = 1000;

struct PrintedColumn {
    QString name;  ///< in the row set
    ado::ColumnType type;
    double width;  ///< in millimetres
};

const PrintedColumn Printed[MovementRow::ColumnCount] = {
    {u"movimento_no"_s, ado::ColumnType::Integer32, 12},
    {u"data"_s, ado::ColumnType::DateTime, 17},
    {u"no_kor"_s, ado::ColumnType::Text, 14},
    {u"nome"_s, ado::ColumnType::Text, 40},
    {u"familiar"_s, ado::ColumnType::Text, 35},
    {u"tipo"_s, ado::ColumnType::Text, 8},
    {u"doc_no"_s, ado::ColumnType::Text, 18},
    {u"doc_valor"_s, ado::ColumnType::Money, 14},
    {u"credito"_s, ado::ColumnType::Money, 14},
    {u"debito"_s, ado::ColumnType::Money, 14},
};

Align printedAlign(int column) {
    const Qt::Alignment shown = MovementList::alignment(column);
    if (shown & Qt::AlignRight) return Align::Right;
    return shown & Qt::AlignHCenter ? Align::Centre : Align::Left;
}

std::vector<Column> columns() {
    std::vector<Column> columns;
    for (int column = 0; column < MovementRow::ColumnCount; ++column)
        columns.push_back({MovementList::heading(column), Printed[column].name,
                           Printed[column].width, printedAlign(column),
                           MovementList::format(column),
                           Printed[column].type == ado::ColumnType::Text});
    return columns;
}

/// Gives `take` the values of each movement, in the order of the keys. False when given up.
template <class Take>
bool forEach(const MovementBook& book, const std::vector<qint32>& keys, const GoesOn& goesOn,
             Take&& take) {
    for (std::size_t from = 0; from < keys.size(); from += Stretch) {
        const std::size_t end = std::min(from + Stretch, keys.size());
        const std::vector<qint32> stretch(keys.begin() + qsizetype(from),
                                          keys.begin() + qsizetype(end));
        QHash<qint32, QVariantList> found;
        for (const MovementRow& row : book.rows(stretch))
            found.insert(row.movimento_id,
                         QVariantList(std::begin(row.values), std::end(row.values)));
        for (const qint32 key : stretch)
            if (const auto row = found.constFind(key); row != found.constEnd()) take(*row);
        if (!goesOn(int(end))) return false;
    }
    return true;
}

}  // namespace

Report movementReport(const QString& filter) {
    Report report{.name = u"prtMovimentos"_s,
                  .caption = u"Movimentos em vigor"_s,
                  .reportHeader = {.name = u"Section4"_s},
                  .pageHeader = {.name = u"Section2"_s},
                  .detail = {.name = u"Section1"_s},
                  .pageFooter = reports::pageFooter(),
                  .reportFooter = {.name = u"Section5"_s}};
    reports::addLetterhead(report.reportHeader, u"Movimentos em vigor"_s);
    report.reportHeader.height += 2;
    if (!filter.isEmpty()) {
        report.reportHeader.items.emplace_back(
            reports::label(0, report.reportHeader.height, page::InnerWidth,
                           letterForLetter(u"Filtro: "_s + filter), {.points = 10, .bold = true}));
        report.reportHeader.height += 1.5 * reports::LineHeight;
    }
    reports::addTitles(report.pageHeader, columns());
    report.detail.height = 0.3;
    reports::addValues(report.detail, columns());
    report.reportFooter.height = 2;
    reports::addTotal(report.reportFooter, Total::Of::Count, u"Total de registos listados:"_s,
                      Printed[0].name, {});
    return report;
}

ado::RecordsetPtr movementRows(const MovementBook& book, const std::vector<qint32>& keys,
                               const GoesOn& goesOn) {
    std::vector<ado::Column> described;
    for (const PrintedColumn& column : Printed) described.push_back({column.name, column.type});
    std::vector<QVariantList> rows;
    const bool isWhole =
        forEach(book, keys, goesOn, [&](const QVariantList& values) { rows.push_back(values); });
    return isWhole ? ado::Recordset::ofValues(described, rows) : nullptr;
}

bool writeMovements(const MovementBook& book, const std::vector<qint32>& keys, const QString& file,
                    const GoesOn& goesOn) {
    CsvFile out(file);
    QStringList headings;
    for (const Column& column : columns()) headings << column.title;
    out.heading(headings);
    if (!forEach(book, keys, goesOn, [&](const QVariantList& values) { out.line(values); }))
        return false;
    out.close();
    return true;
}

}  // namespace host
