// SPDX-License-Identifier: MIT
#include "reports/ExtractReports.h"

#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "reports/Furniture.h"

using namespace Qt::StringLiterals;

namespace reports {

using namespace printing;

namespace {

using core::format::Date;
using core::format::Escudos;
using core::format::Money;

/// A caption that is set when the report is printed.
Label memberLabel(double x, double y, double width, const QString& name) {
    Label made = label(x, y, width, {}, {.bold = true});
    made.name = name;
    return made;
}

/// A text that the member must be able to read whole.
Field whole(Field text) {
    text.whole = true;
    return text;
}

/// Letterhead and member, the same on both extracts.
Section memberHeader() {
    constexpr double Value = 22;
    Section section{.name = u"Section4"_s};
    addLetterhead(section, u"Extracto de Lançamentos"_s);
    double y = section.height + 3;
    section.items.insert(
        section.items.end(),
        {label(0, y, Value, u"NIB:"_s), memberLabel(Value, y, 70, u"nib"_s),
         label(110, y, Value, u"Nº Empresa:"_s), memberLabel(110 + Value, y, 50, u"no_kor"_s)});
    for (const auto& [caption, name] : {std::pair{u"Associado:"_s, u"nome"_s},
                                        {u"Morada:"_s, u"morada"_s},
                                        {u"Localidade:"_s, u"localidade"_s}}) {
        y += LineHeight;
        section.items.insert(
            section.items.end(),
            {label(0, y, Value, caption), memberLabel(Value, y, page::InnerWidth - Value, name)});
    }
    section.height = y + LineHeight + 4;
    return section;
}

/// Adds a line across the page above what follows.
Section totals() {
    return {
        .name = u"Section5"_s, .height = 2, .items = {Rule{QLineF(0, 0.5, page::InnerWidth, 0.5)}}};
}

Report extract(const QString& name) {
    return {.name = name,
            .caption = u"Extracto de Lançamentos"_s,
            .dataMember = u"Print_Extrato1"_s,
            .reportHeader = memberHeader(),
            .pageHeader = {.name = u"Section2"_s},
            .detail = {.name = u"Section1"_s},
            .pageFooter = pageFooter(),
            .reportFooter = totals()};
}

}  // namespace

Report prtExtrato1() {
    constexpr double Gap = 2.5;
    const Style bold{.bold = true};
    const Style boldRight{.bold = true, .align = Align::Right};
    const std::vector<Column> amounts{
        {u"Documento"_s, u"doc_valor"_s, 20, Align::Right, Money},
        // Intentional: a movement does not keep its percentage, so under that title stands the
        // amount that it came to.
        {u"%%"_s, u"comparticipacao"_s, 20, Align::Right, Money},
        {u"Comparticipação"_s, u"comparticipacao"_s, 25, Align::Right, Money},
        {u"Recebido"_s, u"recebido"_s, 19.5, Align::Right, Money},
        {u"Iliquido"_s, u"iliquido"_s, 19.5, Align::Right, Money},
        {u"Saldo Plafond"_s, u"saldo_plafond"_s, 22, Align::Right, Money},
        {u"Liquído"_s, u"liquido"_s, 19.5, Align::Right, Money},
        {u"Saldo C/C"_s, u"saldo_acumulado"_s, 20, Align::Right, Money},
        {u"A Receber"_s, u"debito"_s, 19.5, Align::Right, Money},
    };
    Report report = extract(u"prtExtrato1"_s);
    Section& block = report.detail;
    const double first = 1;
    const double second = first + LineHeight;
    const double third = second + LineHeight;
    block.items = {
        label(2, first, 27, u"Lançamento Nº:"_s),
        field(29, first, 40, u"movimento_no"_s, {}, bold),
        field(134, first, 50, u"data"_s, Date, boldRight),
        whole(field(2, second, 10, u"codABC"_s, {}, bold)),
        label(13, second, 16, u"Familiar:"_s),
        whole(field(29, second, 69, u"Familiar"_s)),
        label(100, second, 15, u"Rúbrica:"_s),
        whole(field(115, second, 69, u"rubrica"_s)),
        label(2, third, 27, u"Nº Documento:"_s),
        whole(field(29, third, 40, u"doc_no"_s)),
        label(71, third, 29, u"Data Documento:"_s),
        field(100, third, 22, u"doc_data"_s, Date),
        label(124, third, 30, u"Modo Pagamento:"_s),
        field(154, third, 30, u"modo_pagamento"_s),
    };
    block.height = third + LineHeight + 0.7;
    addTitles(block, amounts);
    block.height += 0.4;
    addValues(block, amounts);
    block.height += 0.4;
    block.items.emplace_back(
        Band{QRectF(0, 0, page::InnerWidth, block.height), /*shaded*/ false, /*framed*/ true});
    block.height += Gap;

    addTotal(report.reportFooter, Total::Of::Sum, u"Total a Receber:"_s, u"debito"_s, Money);
    addTotal(report.reportFooter, Total::Of::Sum, u"Escudos:"_s, u"euros"_s, Escudos);
    return report;
}

Report rptExtrato2() {
    const std::vector<Column> columns{
        {u"No."_s, u"movimento_no"_s, 12, Align::Right},
        {u"Data"_s, u"data"_s, 17.5, Align::Left, Date},
        {u"F."_s, u"codABC"_s, 10.5, Align::Left, {}, true},
        {u"Tipo"_s, u"tipo"_s, 9.5},
        {u"Rúbrica"_s, u"rubrica"_s, 43, Align::Left, {}, true},
        {u"Documento"_s, u"doc_no"_s, 27, Align::Left, {}, true},
        {u"Valor"_s, u"doc_valor"_s, 19, Align::Right, Money},
        {{}, u"modo_pagamento"_s, 9.5},
        {u"Crédito"_s, u"credito"_s, 19, Align::Right, Money},
        {u"Recebido"_s, u"debito"_s, 19, Align::Right, Money},
    };
    Report report = extract(u"rptExtrato2"_s);
    addTitles(report.reportHeader, columns);
    report.reportHeader.height += 1;
    addValues(report.detail, columns);

    Section& footer = report.reportFooter;
    addTotal(footer, Total::Of::Sum, u"Total Creditado:"_s, u"credito"_s, Money);
    addTotal(footer, Total::Of::Sum, u"Total Recebido:"_s, u"debito"_s, Money);
    addTotal(footer, Total::Of::Sum, u"Total em Dívida:"_s, u"saldo"_s, Money);
    addTotal(footer, Total::Of::Sum, u"Escudos"_s, u"euros"_s, Escudos);
    return report;
}

DataReport extractOf(const ado::Recordset& member, bool detailed) {
    DataReport report(detailed ? prtExtrato1() : rptExtrato2());
    const auto text = [&member](const QString& column) {
        return core::toText(member.Collect(column));
    };
    const std::pair<QString, QString> captions[] = {
        {u"nib"_s, text(u"nib"_s)},
        {u"no_kor"_s, text(u"no_kor"_s)},
        {u"nome"_s, text(u"nome"_s)},
        {u"morada"_s, text(u"morada1"_s)},
        {u"localidade"_s, text(u"code_postal1"_s) + u' ' + text(u"localidade1"_s)},
    };
    for (const auto& [label, caption] : captions) report.setCaption(u"Section4"_s, label, caption);
    return report;
}

}  // namespace reports
