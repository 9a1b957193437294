// SPDX-License-Identifier: MIT
#include "platform/printing/Sections.h"

#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

/// The day as a letter states it.
QString longDate(QDate day) {
    return core::portugueseLocale().toString(day, u"d 'de' MMMM 'de' yyyy"_s);
}

/// The reports are Portuguese wherever they are printed.
QString formatted(const QVariant& value, const QString& format) {
    return core::formatted(value, format, core::portugueseLocale());
}

struct Filled {
    QString text;
    bool open = false;  ///< the number of pages is missing
};

/// Fills in %D, %p and %%. The number of pages comes last, when the text is painted.
Filled filled(const QString& caption, int page) {
    Filled result;
    for (qsizetype at = 0; at < caption.size(); ++at) {
        const bool isMark = caption[at] == u'%' && at + 1 < caption.size();
        const QChar next = isMark ? caption[at + 1] : QChar();
        switch (next.unicode()) {
            case u'D':
                result.text += longDate(core::today());
                break;
            case u'p':
                result.text += QString::number(page);
                break;
            case u'P':
                result.text += u"%P"_s, result.open = true;
                break;
            case u'%':
                result.text += u'%';
                break;
            default:
                result.text += caption[at];
                continue;
        }
        ++at;
    }
    return result;
}

}  // namespace

// --- Rows

size_t RowValues::place(const QString& column) {
    qsizetype at = names_.indexOf(column);
    if (at < 0) {
        at = names_.size();
        names_ << column;
        values_.emplace_back();
    }
    return static_cast<size_t>(at);
}

void RowValues::lookUp(ado::Recordset& rows) {
    QHash<QString, int> known;
    for (int column = rows.columnCount() - 1; column >= 0; --column)
        known.insert(rows.Fields(column).Name().toLower(), column);
    columns_.clear();
    for (const QString& name : names_) {
        const auto column = known.constFind(name.toLower());
        if (column == known.constEnd())
            throw core::Failure(core::NoSuchItem,
                                u"O mapa pede a coluna «%1», que as linhas não têm."_s.arg(name));
        columns_.push_back(*column);
    }
}

void RowValues::read(const ado::Recordset& rows, qint64 row) {
    for (size_t at = 0; at < columns_.size(); ++at) values_[at] = rows.valueAt(row, columns_[at]);
}

// --- Sections

PreparedSection::PreparedSection(const Section& section, Over over, Faces& faces, RowValues& row,
                                 RowValues& details, Tallies& tallies)
    : height_(section.height), over_(over), faces_(faces), row_(row), tallies_(tallies) {
    for (const Item& item : section.items) {
        if (const auto* label = std::get_if<Label>(&item)) {
            if (label->caption.contains(u"%p"_s) || label->caption.contains(u"%P"_s))
                texts_.emplace_back(*label);
            else
                add(std::get<Runs>(texts_.emplace_back(Runs())), *label, 0);
        } else if (const auto* field = std::get_if<Field>(&item)) {
            texts_.emplace_back(FieldOfRow{*field, row.place(field->column)});
        } else if (const auto* total = std::get_if<Total>(&item)) {
            const bool sum = total->of == Total::Of::Sum;
            texts_.emplace_back(TotalSoFar{*total, tallies.add(details.place(total->column), sum)});
        } else if (const auto* rule = std::get_if<Rule>(&item)) {
            lines_.push_back({rule->line, rule->width});
        } else if (const auto* band = std::get_if<Band>(&item)) {
            boxes_.push_back({band->box, band->shaded, band->framed});
        }
    }
}

void PreparedSection::print(Page& page, double top, int number) const {
    for (const Box& box : boxes_)
        page.boxes.push_back({box.rect.translated(page::Margin, top), box.shaded, box.framed});
    for (const Line& line : lines_)
        page.lines.push_back({line.line.translated(page::Margin, top), line.width});
    const size_t first = page.texts.size();
    for (const auto& text : texts_)
        std::visit([&](const auto& kind) { add(page.texts, kind, number); }, text);
    for (size_t at = first; at < page.texts.size(); ++at)
        page.texts[at].baseline += QPointF(page::Margin, top);
}

void PreparedSection::add(Runs& texts, const Runs& fixed, int) const {
    texts.insert(texts.end(), fixed.begin(), fixed.end());
}

void PreparedSection::add(Runs& texts, const Label& label, int number) const {
    const Filled text = filled(label.caption, number);
    const size_t first = texts.size();
    set(texts, faces_, text.text, label.box, label.style, label.lines);
    for (size_t at = first; at < texts.size(); ++at) texts[at].open = text.open;
}

void PreparedSection::add(Runs& texts, const FieldOfRow& of, int) const {
    const QVariant& value = row_.values()[of.place];
    const bool mayCut = value.typeId() == QMetaType::QString && !of.field.whole;
    set(texts, faces_, formatted(value, of.field.format), of.field.box, of.field.style,
        of.field.lines, mayCut ? Overlong::Cut : Overlong::Shrink);
}

void PreparedSection::add(Runs& texts, const TotalSoFar& of, int) const {
    const Tallies::Tally& tally =
        over_ == Over::Group ? tallies_.ofGroup(of.place) : tallies_.ofReport(of.place);
    // Rounded once, to what is shown: display formats show cents, the plain one all that money has.
    const int decimals = of.total.format.isEmpty() ? 4 : 2;
    const QVariant value = of.total.of == Total::Of::Sum
                               ? QVariant::fromValue(tally.sum.rounded(decimals))
                               : QVariant(tally.count);
    set(texts, faces_, formatted(value, of.total.format), of.total.box, of.total.style, 1,
        Overlong::Shrink);
}

}  // namespace printing
