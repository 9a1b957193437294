// SPDX-License-Identifier: MIT
#include "host/RemainderList.h"

#include <algorithm>

#include "data/Codes.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "reports/Furniture.h"

using namespace Qt::StringLiterals;

namespace host {

using namespace printing;
using reports::Column;

namespace {

const QStringList Names{u"pessoa"_s,        u"rubrica"_s,    u"resta"_s,
                        u"limita"_s,        u"plafond"_s,    u"usado"_s,
                        u"por_documento"_s, u"documentos"_s, u"franquia"_s};

QString money(const QVariant& amount) {
    return core::formatted(amount, core::format::Money);
}

QString documentsLeft(const coverage::Remainder& rubric) {
    const QVariant& most = rubric.limits.documents;
    if (core::isNullOrEmpty(most)) return {};
    return QString::number(std::max(0.0, core::toDouble(most) - rubric.used.documents), 'f', 0);
}

/// Without the maximum of one document, which says nothing of the year.
std::vector<coverage::Ceiling> ofTheYear(std::vector<coverage::Ceiling> ceilings) {
    std::erase_if(ceilings, [](const coverage::Ceiling& ceiling) {
        return ceiling.of == coverage::Ceiling::Of::Document;
    });
    return ceilings;
}

}  // namespace

QStringList remainderCells(const coverage::Remainder& rubric, bool isMembers) {
    const std::vector<coverage::Ceiling> ceilings = ofTheYear(rubric.ceilings);
    const coverage::Ceiling* bound = coverage::binding(ceilings);  // the person's own at least
    const bool isSpent = coverage::documentsAreUsedUp(rubric.limits, rubric.used);
    const QVariant& most = rubric.limits.perDocument;
    const bool hasFranchise = rubric.franchise != core::Single();
    return {rubric.name,
            isSpent ? u"documentos esgotados"_s : money(QVariant(bound->left)),
            coverage::ceilingName(bound->of, isMembers),
            money(bound->amount),
            money(QVariant(bound->used)),
            core::isNullOrEmpty(most) ? QString() : money(most),
            documentsLeft(rubric),
            hasFranchise ? money(QVariant(rubric.franchiseLeft)) : QString()};
}

ado::RecordsetPtr remainderRows(const std::vector<PersonRemainders>& persons) {
    std::vector<ado::Column> columns;
    for (const QString& name : Names) columns.push_back({name, ado::ColumnType::Text});
    std::vector<QVariantList> rows;
    for (const PersonRemainders& person : persons)
        for (const coverage::Remainder& rubric : person.rubrics) {
            QVariantList row{person.codABC};
            for (const QString& cell :
                 remainderCells(rubric, person.codABC == data::person::Member))
                row << cell;
            rows.push_back(row);
        }
    return ado::Recordset::ofValues(columns, rows);
}

Report remainderList(const QString& member) {
    const std::vector<Column> columns{
        {u"Pessoa"_s, Names[0], 12},
        {u"Rubrica"_s, Names[1], 54, Align::Left, {}, true},
        {u"Resta"_s, Names[2], 18, Align::Right, {}, true},
        {u"Limita"_s, Names[3], 33, Align::Left, {}, true},
        {u"Plafond"_s, Names[4], 17, Align::Right, {}, true},
        {u"Usado"_s, Names[5], 15, Align::Right, {}, true},
        {u"Por doc."_s, Names[6], 14, Align::Right, {}, true},
        {u"Docs"_s, Names[7], 9, Align::Right, {}, true},
        {u"Franquia"_s, Names[8], 14, Align::Right, {}, true},
    };
    Report report{.name = u"prtResta"_s,
                  .caption = u"O que resta"_s,
                  .reportHeader = {.name = u"Section4"_s},
                  .pageHeader = {.name = u"Section2"_s},
                  .detail = {.name = u"Section1"_s},
                  .pageFooter = reports::pageFooter()};
    reports::addLetterhead(report.reportHeader, u"O que resta dos plafonds"_s);
    report.reportHeader.height += 2;
    report.reportHeader.items.emplace_back(reports::label(0, report.reportHeader.height,
                                                          page::InnerWidth, letterForLetter(member),
                                                          {.points = 10, .bold = true}));
    report.reportHeader.height += 2 * reports::LineHeight;
    reports::addTitles(report.pageHeader, columns);
    report.detail.height = 0.3;
    reports::addValues(report.detail, columns);
    report.detail.height += 0.3;
    return report;
}

}  // namespace host
