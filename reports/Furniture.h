// SPDX-License-Identifier: MIT
#pragma once

#include "platform/printing/Report.h"

/// What the printed reports share: letterhead, page footer, columns, totals.
///
/// A section is built from its top: each function adds its part below what the section holds
/// already and makes the section that much higher. Lengths are millimetres.
namespace reports {

/// Height of a line of text at the usual size.
inline constexpr double LineHeight = 4.8;

/// A fixed text, and the value of a column, each on one line that begins at `x`, `y` of the
/// section.
printing::Label label(double x, double y, double width, const QString& caption,
                      const printing::Style& style = {});
printing::Field field(double x, double y, double width, const QString& column,
                      QStringView format = {}, const printing::Style& style = {});

/// The title on a band.
void addTitle(printing::Section& section, const QString& title);

/// Name and address of the organisation, the day of printing at the right, the title on a band.
void addLetterhead(printing::Section& section, const QString& title);

/// A rule, "Processado por Computador", and at the right page and number of pages.
printing::Section pageFooter();

/// The same with the day of printing in the middle, for listings without a letterhead.
printing::Section datedPageFooter();

/// A column of a listing.
struct Column {
    QString title;
    QString column;
    double width;
    printing::Align align = printing::Align::Left;
    QStringView format = {};  ///< of core/Format.h
    bool whole = false;       ///< a text too long is set smaller, so that it can be read whole
};

/// The columns' titles on a shaded band, side by side from the left margin.
void addTitles(printing::Section& section, const std::vector<Column>& columns);
/// The columns' values under their titles.
void addValues(printing::Section& section, const std::vector<Column>& columns);

/// A line at the right: the caption and the figure over all rows.
void addTotal(printing::Section& section, printing::Total::Of of, const QString& caption,
              const QString& column, QStringView format);

}  // namespace reports
