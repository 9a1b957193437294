// SPDX-License-Identifier: MIT
#include "reports/HospitalReport.h"

#include "platform/core/Format.h"
#include "reports/Furniture.h"

using namespace Qt::StringLiterals;

namespace reports {

using namespace printing;

namespace {

using core::format::Date;
using core::format::Money;

constexpr double BarHeight = 5.6;
constexpr double AmountWidth = 20;
constexpr double AmountsLeft = page::InnerWidth - 5 * AmountWidth;

/// The amounts of a movement, side by side from AmountsLeft to the right margin.
const std::vector<Column>& amounts() {
    static const std::vector<Column> columns{
        {u"Valor"_s, u"doc_valor"_s, AmountWidth, Align::Right, Money},
        {u"Incidência"_s, u"incidencia"_s, AmountWidth, Align::Right, Money},
        {u"Crédito"_s, u"credito"_s, AmountWidth, Align::Right, Money},
        {u"Débito"_s, u"debito"_s, AmountWidth, Align::Right, Money},
        {u"Dívida"_s, u"divida"_s, AmountWidth, Align::Right, Money},
    };
    return columns;
}

std::vector<Column> withAmounts(std::vector<Column> columns) {
    columns.insert(columns.end(), amounts().begin(), amounts().end());
    return columns;
}

/// The hospital on a bar, and the titles of the lines below it. A title may stand over two columns.
Section head() {
    Section section{.name = u"Print_frmListagemHospitais_Header"_s, .onEachPage = true};
    const Style bold{.bold = true};
    constexpr double Top = (BarHeight - LineHeight) / 2;
    Field name = field(19, Top, 118, u"hospital_nome"_s, {}, bold);
    name.whole = true;
    section.items = {Band{QRectF(0, 0, page::InnerWidth, BarHeight)},
                     label(1.1, Top, 18, u"Hospital:"_s), name, label(140, Top, 15, u"Código:"_s),
                     field(155, Top, 30, u"hospital_code"_s, {}, bold)};
    section.height = BarHeight + 0.5;
    addTitles(section, withAmounts({{u"No"_s, {}, 11.5, Align::Right},
                                    {u"Data"_s, {}, 17},
                                    {u"Associado"_s, {}, 21.5},
                                    {u"Documento"_s, {}, 36}}));
    section.height += 0.4;
    return section;
}

Section line() {
    Section section{.name = u"Print_frmListagemHospitais_detail_Detail"_s};
    addValues(section, withAmounts({{{}, u"movimento_no"_s, 11.5, Align::Right},
                                    {{}, u"data"_s, 17, Align::Left, Date},
                                    {{}, u"no_kor"_s, 12.5, Align::Left, {}, true},
                                    {{}, u"codABC"_s, 9, Align::Left, {}, true},
                                    {{}, u"doc_no"_s, 24, Align::Left, {}, true},
                                    {{}, u"rubrica"_s, 12, Align::Left, {}, true}}));
    return section;
}

/// The sums of a hospital's lines on a bar, each under its column.
Section totals() {
    constexpr double Padding = 1.1;
    constexpr double Top = 0.4;
    constexpr double TextTop = Top + (BarHeight - LineHeight) / 2;
    const Style bold{.points = 8, .bold = true, .align = Align::Right};
    Section section{.name = u"Print_frmListagemHospitais_Footer"_s, .height = Top + BarHeight + 5};
    section.items = {Band{QRectF(0, Top, page::InnerWidth, BarHeight)},
                     label(Padding, TextTop, AmountsLeft, u"Totais:"_s, {.bold = true})};
    double x = AmountsLeft;
    for (const Column& column : amounts()) {
        section.items.emplace_back(
            Total{Total::Of::Sum, column.column,
                  QRectF(x + Padding, TextTop, column.width - 2 * Padding, LineHeight),
                  column.format.toString(), bold});
        x += column.width;
    }
    return section;
}

}  // namespace

Report Print_frmListagemHospitais() {
    const QString title = u"Listagem de Hospitais"_s;
    Report report{.name = u"Print_frmListagemHospitais"_s,
                  .caption = title,
                  .dataMember = u"Print_frmListagemHospitais"_s,
                  .chapter = u"Print_frmListagemHospitais_detail"_s,
                  .bookmark = {u"hospital_code"_s, u"hospital_nome"_s},
                  .reportHeader = {.name = u"Section4"_s},
                  .pageHeader = {.name = u"Section2"_s},
                  .groupHeader = head(),
                  .detail = line(),
                  .groupFooter = totals(),
                  .pageFooter = pageFooter(),
                  .reportFooter = {.name = u"Section5"_s}};
    addTitle(report.reportHeader, title);
    report.reportHeader.height += 4;
    return report;
}

}  // namespace reports
