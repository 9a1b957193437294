// SPDX-License-Identifier: MIT
#include "reports/DebtReports.h"

#include "platform/core/Format.h"
#include "reports/Furniture.h"
#include "reports/Organisation.h"

using namespace Qt::StringLiterals;

namespace reports {

using namespace printing;

namespace {

const Style Plain{.points = 9.5};
const Style Bold{.points = 9.5, .bold = true};

/// A place of the paper, in millimetres from its edges, as a place between the margins.
constexpr double inMargins(double millimetres) {
    return millimetres - page::Margin;
}

void addAddress(Section& letter) {
    constexpr double Left = inMargins(20);
    constexpr double Value = Left + 21;
    constexpr double Width = inMargins(90) - Value;
    constexpr double Line = 6.5;
    double y = inMargins(50);
    for (const auto& [caption, column] : {std::pair{u"Associado:"_s, u"nome"_s},
                                          {u"Nº Empresa:"_s, u"no_kor"_s},
                                          {u"Morada:"_s, u"morada1"_s},
                                          {u"Localidade:"_s, u"code_completo"_s}}) {
        Field value = field(Value, y, Width, column);
        value.whole = true;
        letter.items.emplace_back(label(Left, y, Value - Left, caption));
        letter.items.emplace_back(value);
        y += Line;
    }
}

void addFoldMarks(Section& letter) {
    for (const double fold : {105.0, 148.5, 210.0}) {
        const double y = inMargins(fold);
        letter.items.emplace_back(Rule{QLineF(inMargins(5), y, inMargins(8), y), 0.1});
    }
}

void addText(Section& letter) {
    constexpr double Left = inMargins(20);
    constexpr double Width = page::InnerWidth - Left;
    constexpr double Line = 6.5;
    double y = inMargins(112);
    const auto line = [&](const QString& text, double lines = 1) {
        letter.items.emplace_back(label(Left, y, Width, text, Plain));
        y += lines * Line;
    };
    letter.items.emplace_back(label(Left, inMargins(94), 20, u"Assunto:"_s, Plain));
    letter.items.emplace_back(
        label(Left + 20, inMargins(94), 90, u"Regularização de Débitos"_s, Bold));
    letter.items.emplace_back(label(Left + 100, inMargins(94), Width - 100, u"%D"_s,
                                    {.points = 9.5, .align = Align::Right}));
    line(u"Caro(a) Associado(a);"_s, 2);
    line(
        u"Após a utilização dos serviços médico-hospitalares convencionados, o saldo devedor ao "
        "Tesmar é,"_s);
    line(u" na presente data, de Euros:"_s, 0);
    letter.items.emplace_back(field(Left + 50, y, 50, u"divida"_s, core::format::Money, Bold));
    y += 2 * Line;
    line(
        u"Lembramos que o referido saldo representa a parte não comparticipada, pelo Plano de "
        "Saúde, do total das despesas"_s);
    line(
        u"hospitalares e eventuais honorários médicos. O saldo devedor poderá ainda ser "
        "proveniente de créditos indevidos."_s,
        2);
    line(
        u"Assim solicitamos a sua presença no Corvenda o mais breve possível a fim de regularizar "
        "o seu débito."_s,
        2);
    line(u"Com os nossos melhores cumprimentos,"_s, 3);
    line(u"A Direcção"_s, 5);
    letter.items.emplace_back(label(Left, y, Width, letterForLetter(organisationName()), Bold));
    letter.items.emplace_back(
        label(Left, y + LineHeight, Width, letterForLetter(organisationAddress()), Plain));
}

}  // namespace

Report Print_frmListagemDividas() {
    const std::vector<Column> columns{
        {u"Nº KOR"_s, u"no_kor"_s, 30},
        {u"Nome"_s, u"nome"_s, 116, Align::Left, {}, true},
        {u"Dívida"_s, u"divida"_s, 40, Align::Right, core::format::Money},
    };
    Report report{.name = u"Print_frmListagemDividas"_s,
                  .caption = u"Listagem de Dívidas de Associados"_s,
                  .dataMember = u"Print_frmListagemDividas"_s,
                  .reportHeader = {.name = u"Section4"_s},
                  .pageHeader = {.name = u"Section2"_s},
                  .detail = {.name = u"Section1"_s, .height = 0.3},
                  .pageFooter = pageFooter(),
                  .reportFooter = {.name = u"Section5"_s, .height = 2}};
    addTitle(report.reportHeader, report.caption);
    report.reportHeader.items.emplace_back(label(
        0, report.reportHeader.height + 1, page::InnerWidth, u"%D"_s, {.align = Align::Right}));
    report.reportHeader.height += LineHeight + 3;
    addTitles(report.pageHeader, columns);
    addValues(report.detail, columns);
    report.detail.height += 0.3;
    addTotal(report.reportFooter, Total::Of::Count, u"Total de registos listados:"_s, u"no_kor"_s,
             {});
    report.reportFooter.items.emplace_back(Rule{QLineF(
        0, report.reportFooter.height + 0.5, page::InnerWidth, report.reportFooter.height + 0.5)});
    report.reportFooter.height += 1.5;
    addTotal(report.reportFooter, Total::Of::Sum, u"Total de Dívidas:"_s, u"divida"_s,
             core::format::Money);
    return report;
}

Report Print_frmCartasDividas() {
    Report report{.name = u"Print_frmCartasDividas"_s,
                  .caption = u"Cartas de Dívidas"_s,
                  .dataMember = u"Print_frmListagemDividas"_s,
                  .bookmark = {u"no_kor"_s, u"nome"_s},
                  .reportHeader = {.name = u"Section4"_s},
                  .pageHeader = {.name = u"Section2"_s},
                  .detail = {.name = u"Section1"_s},
                  .pageFooter = {.name = u"Section3"_s,
                                 .height = 8,
                                 .items = {Rule{QLineF(0, 2.5, page::InnerWidth, 2.5)},
                                           label(0, 3.2, page::InnerWidth,
                                                 u"Processado por Computador"_s, {.points = 8})}},
                  .reportFooter = {.name = u"Section5"_s}};
    addAddress(report.detail);
    addFoldMarks(report.detail);
    addText(report.detail);
    // As high as a page: each row has one of its own.
    report.detail.height = page::InnerHeight - report.pageFooter.height;
    return report;
}

}  // namespace reports
