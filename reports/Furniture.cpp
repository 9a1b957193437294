// SPDX-License-Identifier: MIT
#include "reports/Furniture.h"

#include "reports/Organisation.h"

using namespace Qt::StringLiterals;

namespace reports {

using namespace printing;

namespace {

/// The gap between a text and the edge of its column.
constexpr double Padding = 1.1;

template <class MakeItem>
void addColumns(Section& section, const std::vector<Column>& columns, const MakeItem& make) {
    double x = 0;
    for (const Column& column : columns) {
        section.items.emplace_back(make(
            column, QRectF(x + Padding, section.height, column.width - 2 * Padding, LineHeight)));
        x += column.width;
    }
    section.height += LineHeight;
}

}  // namespace

Label label(double x, double y, double width, const QString& caption, const Style& style) {
    return {.name = {}, .box = QRectF(x, y, width, LineHeight), .caption = caption, .style = style};
}

Field field(double x, double y, double width, const QString& column, QStringView format,
            const Style& style) {
    return {.column = column,
            .box = QRectF(x, y, width, LineHeight),
            .format = format.toString(),
            .style = style};
}

void addTitle(Section& section, const QString& title) {
    constexpr double BandHeight = 9;
    const double top = section.height;
    section.items.insert(section.items.end(),
                         {Band{QRectF(0, top, page::InnerWidth, BandHeight)},
                          Label{{},
                                QRectF(3, top, page::InnerWidth - 6, BandHeight),
                                title,
                                {.points = 13, .bold = true}}});
    section.height += BandHeight;
}

void addLetterhead(Section& section, const QString& title) {
    const double top = section.height;
    section.items.insert(
        section.items.end(),
        {Label{{},
               QRectF(0, top, 120, 7),
               letterForLetter(organisationName()),
               {.points = 14, .bold = true}},
         label(0, top + 7, 120, letterForLetter(organisationAddress())),
         label(120, top + 1.5, page::InnerWidth - 120, u"%D"_s, {.align = Align::Right})});
    section.height += 13;
    addTitle(section, title);
}

Section pageFooter() {
    constexpr double Half = page::InnerWidth / 2;
    const Style small{.points = 8};
    const Style smallRight{.points = 8, .align = Align::Right};
    return {.name = u"Section3"_s,
            .height = 8,
            .items = {Rule{QLineF(0, 2.5, page::InnerWidth, 2.5)},
                      label(0, 3.2, Half, u"Processado por Computador"_s, small),
                      label(Half, 3.2, Half, u"Página: %p / %P"_s, smallRight)}};
}

Section datedPageFooter() {
    Section footer = pageFooter();
    constexpr double Third = page::InnerWidth / 3;
    footer.items.emplace_back(
        label(Third, 3.2, Third, u"%D"_s, {.points = 8, .align = Align::Centre}));
    return footer;
}

void addTitles(Section& section, const std::vector<Column>& columns) {
    section.items.emplace_back(Band{QRectF(0, section.height, page::InnerWidth, LineHeight)});
    addColumns(section, columns, [](const Column& column, const QRectF& box) {
        return Label{{}, box, column.title, {.points = 7.5, .bold = true, .align = column.align}};
    });
}

void addValues(Section& section, const std::vector<Column>& columns) {
    addColumns(section, columns, [](const Column& column, const QRectF& box) {
        return Field{.column = column.column,
                     .box = box,
                     .format = column.format.toString(),
                     .style = {.points = 8, .align = column.align},
                     .whole = column.whole};
    });
}

void addTotal(Section& section, Total::Of of, const QString& caption, const QString& column,
              QStringView format) {
    constexpr double FigureWidth = 40;
    constexpr double CaptionWidth = 50;
    constexpr double Left = page::InnerWidth - FigureWidth - CaptionWidth;
    const Style bold{.bold = true, .align = Align::Right};
    section.items.emplace_back(
        label(Left, section.height, CaptionWidth, caption, {.align = Align::Right}));
    section.items.emplace_back(Total{
        of, column, QRectF(Left + CaptionWidth, section.height, FigureWidth - Padding, LineHeight),
        format.toString(), bold});
    section.height += LineHeight;
}

}  // namespace reports
