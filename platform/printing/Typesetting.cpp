// SPDX-License-Identifier: MIT
#include "platform/printing/Typesetting.h"

#include <QGlyphRun>
#include <QPainter>
#include <QTextLayout>
#include <QVarLengthArray>
#include <algorithm>
#include <cmath>

using namespace Qt::StringLiterals;

namespace printing {

namespace {

QFont fontOf(const Style& style) {
    QFont font(u"Arial"_s);
    font.setPixelSize(static_cast<int>(std::lround(style.points * UnitsPerInch / 72)));
    font.setBold(style.bold);
    font.setItalic(style.italic);
    font.setHintingPreference(QFont::PreferNoHinting);
    font.setKerning(false);
    return font;
}

/// Control characters and ends of lines and paragraphs.
bool isBlank(QChar c) {
    return c < u' ' || (c >= u'\u007f' && c < u'\u00a0') || c == QChar::LineSeparator ||
           c == QChar::ParagraphSeparator;
}

/// Only what can stand on one line.
QString cleaned(const QString& text) {
    if (std::none_of(text.begin(), text.end(), isBlank)) return text;
    QString clean = text;
    std::replace_if(clean.begin(), clean.end(), isBlank, u' ');
    return clean;
}

double alignedLeft(const QRectF& box, double width, Align align) {
    const double room = box.width() - width;
    return box.left() + (align == Align::Left ? 0 : align == Align::Right ? room : room / 2);
}

/// Breaks a text between words; the last line holds all that is left.
QStringList broken(const QString& text, const Face& face, double width, int lines) {
    QTextLayout layout(text, face.font);
    QStringList result;
    layout.beginLayout();
    while (result.size() < lines - 1) {
        QTextLine line = layout.createLine();
        if (!line.isValid()) break;
        line.setLineWidth(width * UnitsPerMillimetre);
        const qsizetype end = line.textStart() + line.textLength();
        result << text.mid(line.textStart(), line.textLength()).trimmed();
        if (end >= text.size()) break;
        if (result.size() == lines - 1) result << text.mid(end).trimmed();
    }
    layout.endLayout();
    return result;
}

void setLine(std::vector<TextRun>& into, Faces& faces, QString text, const QRectF& box,
             const Style& style, Overlong overlong) {
    const Face* face = &faces.of(style);
    double width = face->width(text);
    if (width > box.width() && overlong == Overlong::Shrink) {
        Style smaller = style;
        // Sizes go by half points, and never below what can be read.
        smaller.points = std::max(5.0, std::floor(2 * style.points * box.width() / width) / 2);
        face = &faces.of(smaller);
        width = face->width(text);
    }
    if (width > box.width()) {
        text = face->elided(text, box.width());
        width = face->width(text);
    }
    const double top = box.top() + (box.height() - face->height()) / 2;
    const QPointF baseline(alignedLeft(box, width, style.align), top + face->ascent());
    into.push_back({baseline, width, text, face->style, false});
}

}  // namespace

Face::Face(const Style& of)
    : style(of), font(fontOf(of)), metrics_(font), raw_(QRawFont::fromFont(font)) {}

const Face::Letter* Face::letter(QChar c) const {
    // The currency sign, which stands in nearly every row, takes the place of the letter 0.
    const size_t at = c == u'€' ? 0 : c.unicode();
    if (at >= letters_.size() || c == QChar::SoftHyphen) return nullptr;
    Letter& known = letters_[at];
    if (known.width < 0) {
        known.glyph = raw_.glyphIndexesForString(c).value(0);
        known.width = std::round(metrics_.horizontalAdvance(c));
    }
    return known.glyph != 0 ? &known : nullptr;
}

double Face::width(const QString& text) const {
    double units = 0;
    for (const QChar c : text) {
        const Letter* known = letter(c);
        if (!known) return metrics_.horizontalAdvance(text) / UnitsPerMillimetre;
        units += known->width;
    }
    return units / UnitsPerMillimetre;
}

void Face::draw(QPainter& painter, const QPointF& at, const QString& text) const {
    QVarLengthArray<quint32, 64> glyphs;
    QVarLengthArray<QPointF, 64> places;
    double x = 0;
    for (const QChar c : text) {
        const Letter* known = letter(c);
        if (!known) return painter.drawText(at, text);
        glyphs.append(known->glyph);
        places.append(QPointF(x, 0));
        x += known->width;
    }
    QGlyphRun run;
    run.setRawFont(raw_);
    run.setRawData(glyphs.constData(), places.constData(), static_cast<int>(glyphs.size()));
    painter.drawGlyphRun(at, run);
}

QString Face::elided(const QString& text, double width) const {
    return metrics_.elidedText(text, Qt::ElideRight, width * UnitsPerMillimetre);
}

const Face& Faces::of(const Style& style) {
    for (const Face& face : faces_)
        if (face.style == style) return face;
    return faces_.emplace_front(style);
}

void set(std::vector<TextRun>& into, Faces& faces, const QString& text, const QRectF& box,
         const Style& style, int lines, Overlong overlong) {
    if (text.isEmpty()) return;
    const QString clean = cleaned(text);
    if (lines <= 1) return setLine(into, faces, clean, box, style, overlong);
    QRectF slot = box;
    slot.setHeight(box.height() / lines);
    for (const QString& line : broken(clean, faces.of(style), box.width(), lines)) {
        if (!line.isEmpty()) setLine(into, faces, line, slot, style, overlong);
        slot.translate(0, slot.height());
    }
}

}  // namespace printing
