// SPDX-License-Identifier: MIT
#pragma once

#include <QLineF>
#include <QRectF>
#include <QString>
#include <QStringList>
#include <variant>
#include <vector>

/// Printed reports: a declaration (this file), one layout run that turns rows into pages, and three
/// ways out of the same pages: preview, printer, PDF.
///
/// Lengths are millimetres from the left margin and from the top of the section.
namespace printing {

enum class Align { Left, Centre, Right };

/// How a text is set. The face is Arial throughout.
struct Style {
    double points = 9;
    bool bold = false;
    bool italic = false;
    Align align = Align::Left;

    bool operator==(const Style&) const = default;
};

/// A fixed text. In it %D is the day of printing in long form, %p the page's number, %P the number
/// of pages, %% a percent sign.
struct Label {
    QString name;  ///< for captions that are set at run time; empty where none is
    QRectF box;
    QString caption;
    Style style;
    int lines = 1;  ///< most lines; a longer text is wrapped, then cut with an ellipsis
};

/// A text as a label's caption that is printed letter for letter: a "%p" in somebody's name must
/// not turn into the page's number.
inline QString letterForLetter(QString text) {
    return text.replace(u'%', QStringLiteral("%%"));
}

/// A column of the current row, null being empty: of the row that is printed or, around a page's
/// rows, of the one about to be. A text too long for its box ends in an ellipsis; a number is set
/// smaller.
struct Field {
    QString column;
    QRectF box;
    QString format;  ///< as core::formatted takes it; empty for the plain value
    Style style;
    int lines = 1;
    bool whole = false;  ///< a text, too, is set smaller: one that the reader cannot do without
};

/// A figure over the rows printed so far: of the report in its footer, of the group in the group's.
struct Total {
    enum class Of { Sum, Count };
    Of of;
    QString column;  ///< a sum passes nulls over; a count takes every row
    QRectF box;
    QString format;
    Style style;
};

/// A straight line; its width in millimetres.
struct Rule {
    QLineF line;
    double width = 0.2;
};

/// A box behind what follows it: shaded, framed or both.
struct Band {
    QRectF box;
    bool shaded = true;
    bool framed = false;
};

/// Anything that a section can hold.
using Item = std::variant<Label, Field, Total, Rule, Band>;

/// Items in the order in which they are painted. A section is never split over two pages.
struct Section {
    QString name = {};
    double height = 0;  ///< 0 for a section that is not there
    std::vector<Item> items = {};
    bool onEachPage = false;  ///< a group header: again on each page that the group goes on to
};

/// A report as it is designed. Sections in printing order.
struct Report {
    QString name = {};
    QString caption = {};     ///< title of preview, print job and PDF
    QString dataMember = {};  ///< the row set of the data environment that it is bound to
    /// Chapter whose rows the detail prints, one group for each row of the row set; empty for a
    /// report of one level.
    QString chapter = {};
    /// Columns whose values, joined by " - ", name a place that a reader of the PDF can jump to:
    /// one for each group, or for each row of a report of one level. None when empty.
    QStringList bookmark = {};
    Section reportHeader = {};
    Section pageHeader = {};
    Section groupHeader = {};
    Section detail = {};
    Section groupFooter = {};
    Section pageFooter = {};
    Section reportFooter = {};
};

/// The paper of all reports, A4 upright, in millimetres.
namespace page {
inline constexpr double Width = 210;
inline constexpr double Height = 297;
inline constexpr double Margin = 12;
// What lies between the margins.
inline constexpr double InnerWidth = Width - 2 * Margin;
inline constexpr double InnerHeight = Height - 2 * Margin;
}  // namespace page

}  // namespace printing
