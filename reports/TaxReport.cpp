// SPDX-License-Identifier: MIT
#include "reports/TaxReport.h"

#include "platform/core/Format.h"
#include "reports/Furniture.h"
#include "reports/Organisation.h"

using namespace Qt::StringLiterals;

namespace reports {

using namespace printing;

namespace {

constexpr double Text = 10;  ///< points of the running text
constexpr double Line = 7.5;
const Style Plain{.points = Text};
const Style Bold{.points = Text, .bold = true};
const Style BoldRight{.points = Text, .bold = true, .align = Align::Right};

Field whole(Field text) {
    text.whole = true;
    return text;
}

/// A value of the running text behind its caption, on the same line.
void addPair(Section& page, double x, double y, double captionWidth, const QString& caption,
             Field value) {
    page.items.emplace_back(label(x, y, captionWidth, caption, Plain));
    value.box.moveTo(x + captionWidth, y);
    page.items.emplace_back(value);
}

double addHead(Section& page) {
    const Style title{.points = 18, .bold = true, .align = Align::Centre};
    const Style under{.points = 11, .bold = true, .align = Align::Centre};
    page.items = {
        Label{{},
              QRectF(0, 0, 120, 7),
              letterForLetter(organisationName()),
              {.points = 14, .bold = true}},
        label(0, 7, 120, letterForLetter(organisationAddress())),
        Rule{QLineF(0, 14, page::InnerWidth, 14)},
        Label{{}, QRectF(0, 38, page::InnerWidth, 9), u"DECLARAÇÃO"_s, title},
        Label{{}, QRectF(0, 49, page::InnerWidth, 6), u"ZELMAR COLECTIVO DO TESMAR"_s, under}};
    return 74;
}

double addText(Section& page, double y) {
    page.items.emplace_back(label(
        0, y, page::InnerWidth,
        u"Ao abrigo do código nr.1 alínea a) do Artigo n. 55 do Código do I.R.S. declara-se que as "
        "despesas de"_s,
        Plain));
    y += Line;
    addPair(page, 0, y, 72, u"saúde pagas e não reembolsadas pelo Sr.(a) "_s,
            whole(field(0, 0, page::InnerWidth - 72, u"nome"_s, {}, Bold)));
    y += Line;
    addPair(page, 0, y, 45, u"com o número de empresa:"_s, field(0, 0, 32, u"no_kor"_s, {}, Bold));
    addPair(page, 79, y, 30, u"e contribuinte no.: "_s,
            whole(field(0, 0, page::InnerWidth - 109, u"no_contribuinte"_s, {}, Bold)));
    y += Line;
    addPair(page, 0, y, 39.5, u"foram, durante o ano de"_s, field(0, 0, 14, u"ano"_s, {}, Bold));
    addPair(page, 52, y, 38, u"no montante de Euros:"_s,
            field(0, 0, 40, u"tresponsabilidade"_s, core::format::Money, Bold));
    return y + 2.4 * Line;
}

double addTotals(Section& page, double y) {
    for (const auto& [caption, column] :
         {std::pair{u"Total de documentos entregues Euros:"_s, u"tdoc_valor"_s},
          {u"Total comparticipado Euros:"_s, u"tcredito"_s},
          {u"(*) Total comparticipado por Outras Entidades Euros:"_s, u"trecebido"_s}}) {
        addPair(page, 0, y, 96, caption, field(0, 0, 44, column, core::format::Money, BoldRight));
        y += Line;
    }
    return y + 2 * Line;
}

void addFoot(Section& page, double y) {
    const Style centre{.points = Text, .align = Align::Centre};
    page.items.emplace_back(label(0, y, page::InnerWidth, u"Lisboa, %D"_s, Plain));
    page.items.emplace_back(label(106, y + 2 * Line, 80, u"A Direcção"_s, centre));
    page.items.emplace_back(Rule{QLineF(106, y + 4.6 * Line, page::InnerWidth, y + 4.6 * Line)});
    y = 205;
    for (const auto& column : {u"no_kor"_s, u"nome"_s, u"morada"_s, u"localidade_completo"_s}) {
        page.items.emplace_back(whole(field(8, y, 100, column, {}, Plain)));
        y += LineHeight;
    }
}

Section footerWithNote() {
    const Style small{.points = 8};
    return {
        .name = u"Section3"_s,
        .height = 17,
        .items = {
            Rule{QLineF(0, 2.5, page::InnerWidth, 2.5)},
            label(0, 3.2, page::InnerWidth, u"Processado por Computador"_s, small),
            label(0, 8, page::InnerWidth,
                  u"(*)  Nestes casos e para efeito de conferências fiscais, o Tesmar apenas "
                  "se responsabiliza pelas fotocópias de"_s,
                  small),
            label(0, 12, page::InnerWidth,
                  u"documentos que hajam sido comparticipados por Outras Entidades."_s, small)}};
}

}  // namespace

Report prtIRS() {
    Report report{.name = u"prtIRS"_s,
                  .caption = u"Declaração de IRS"_s,
                  .dataMember = u"Print_Irs"_s,
                  .bookmark = {u"no_kor"_s, u"nome"_s},
                  .reportHeader = {.name = u"Section4"_s},
                  .pageHeader = {.name = u"Section2"_s},
                  .detail = {.name = u"Section1"_s},
                  .pageFooter = footerWithNote(),
                  .reportFooter = {.name = u"Section5"_s}};
    Section& page = report.detail;
    addFoot(page, addTotals(page, addText(page, addHead(page))));
    // As high as a page: each row has one of its own.
    page.height = page::InnerHeight - report.pageFooter.height;
    return report;
}

}  // namespace reports
