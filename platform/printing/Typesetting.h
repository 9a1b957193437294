// SPDX-License-Identifier: MIT
#pragma once

#include <QFont>
#include <QFontMetricsF>
#include <QRawFont>
#include <array>
#include <list>
#include <vector>

#include "platform/printing/Pages.h"

class QPainter;

/// Texts set into boxes. Everything is measured with unhinted fonts in units of 1/600 inch,
/// whatever the screen is, so that a page is the same wherever it is laid out and painted.
namespace printing {

/// In which everything is measured.
inline constexpr int UnitsPerInch = 600;
inline constexpr double UnitsPerMillimetre = UnitsPerInch / 25.4;

/// A style's font, its size in those units. Letters are whole units wide and not kerned: a text is
/// as wide as its letters together, and a PDF is a tenth smaller.
class Face {
public:
    explicit Face(const Style& of);

    // All lengths in millimetres.

    double width(const QString& text) const;
    /// The text cut so that it is no wider, with an ellipsis where something was cut.
    QString elided(const QString& text, double width) const;
    /// Of a line, from its upper edge down to where the letters stand.
    double ascent() const { return metrics_.ascent() / UnitsPerMillimetre; }
    /// Of a line.
    double height() const { return metrics_.height() / UnitsPerMillimetre; }

    /// Paints a text, `at` being the painter's units, with the painter's font set to this one.
    void draw(QPainter& painter, const QPointF& at, const QString& text) const;

    const Style style;
    const QFont font;

private:
    struct Letter {
        quint32 glyph = 0;
        double width = -1;  ///< in units; negative while the letter is not known
    };
    /// Null for a letter of scripts that join or reorder theirs, and for one that the font lacks:
    /// a text with such a letter is left to the toolkit as a whole, which takes twice as long.
    const Letter* letter(QChar c) const;

    QFontMetricsF metrics_;
    QRawFont raw_;
    mutable std::array<Letter, 0x250> letters_;
};

/// Faces made so far: a font is costly to make, and a report uses few.
class Faces {
public:
    /// The face of a style; it stays where it is.
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

}  // namespace printing
