// SPDX-License-Identifier: MIT
#pragma once

#include <QFont>
#include <QFontMetricsF>
#include <list>
#include <vector>

#include "platform/reports/Pages.h"

/// Texts set into boxes. Everything is measured with unhinted fonts in units of 1/1200 inch,
/// whatever the screen is, so that a page is the same wherever it is laid out and painted.
namespace reports {

inline constexpr double UnitsPerMillimetre = 1200 / 25.4;

/// A style's font, its size in those units.
struct Face {
    explicit Face(const Style& of);
    Style style;
    QFont font;
    QFontMetricsF metrics;

    double width(const QString& text) const;  ///< millimetres
};

/// Faces made so far: a font is costly to make, and a report uses few.
class Faces {
public:
    const Face& of(const Style& style);

private:
    std::list<Face> faces_;
};

/// What happens to a line wider than its box: a text is cut with an ellipsis; a number, whose last
/// digits nobody can do without, is set smaller.
enum class Overlong { Cut, Shrink };

/// Sets a text into a box of so many lines of equal height, each centred in its height. Control
/// characters become blanks; an empty text gives no run.
void set(std::vector<TextRun>& into, Faces& faces, const QString& text, const QRectF& box,
         const Style& style, int lines = 1, Overlong overlong = Overlong::Cut);

}  // namespace reports
