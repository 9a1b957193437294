// SPDX-License-Identifier: MIT
#include "platform/reports/Sections.h"

#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

/// The day as a letter states it. The reports are Portuguese wherever they are printed.
QString longDate(QDate day) {
    return QLocale(QLocale::Portuguese, QLocale::Portugal)
        .toString(day, u"d 'de' MMMM 'de' yyyy"_s);
}

struct Filled {
    QString text;
    bool open = false;  ///< the number of pages is missing
};

/// Fills in %D, %p and %%. The number of pages comes last, when the text is painted.
Filled filled(const QString& caption, int page) {
    Filled result;
    for (qsizetype at = 0; at < caption.size(); ++at) {
        const QChar next = caption[at] == u'%' ? caption.mid(at + 1, 1).front() : QChar();
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

void setLabel(std::vector<TextRun>& into, Faces& faces, const Label& label, int page) {
    const Filled text = filled(label.caption, page);
    const size_t before = into.size();
    set(into, faces, text.text, label.box, label.style, label.lines);
    for (size_t at = before; at < into.size(); ++at) into[at].open = text.open;
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
                numbered_.push_back(*label);
            else
                setLabel(fixed_.texts, faces_, *label, 0);
        } else if (const auto* field = std::get_if<Field>(&item)) {
            fields_.emplace_back(*field, row.place(field->column));
        } else if (const auto* total = std::get_if<Total>(&item)) {
            const bool sum = total->of == Total::Of::Sum;
            totals_.emplace_back(*total, tallies.add(details.place(total->column), sum));
        } else if (const auto* rule = std::get_if<Rule>(&item)) {
            fixed_.lines.push_back({rule->line, rule->width});
        } else if (const auto* band = std::get_if<Band>(&item)) {
            fixed_.boxes.push_back({band->box, band->shaded, band->framed});
        }
    }
}

void PreparedSection::print(Page& page, double top, int number) const {
    for (const Box& box : fixed_.boxes)
        page.boxes.push_back({box.rect.translated(page::Margin, top), box.shaded, box.framed});
    for (const Line& line : fixed_.lines)
        page.lines.push_back({line.line.translated(page::Margin, top), line.width});
    const size_t first = page.texts.size();
    page.texts.insert(page.texts.end(), fixed_.texts.begin(), fixed_.texts.end());
    for (const Label& label : numbered_) setLabel(page.texts, faces_, label, number);
    for (const auto& [field, place] : fields_) {
        const QVariant& value = row_.values()[place];
        const bool isText = value.typeId() == QMetaType::QString;
        set(page.texts, faces_, core::formatted(value, field.format), field.box, field.style,
            field.lines, isText ? Overlong::Cut : Overlong::Shrink);
    }
    for (const auto& [total, place] : totals_) {
        const Tallies::Tally& tally =
            over_ == Over::Group ? tallies_.ofGroup(place) : tallies_.ofReport(place);
        const QVariant value =
            total.of == Total::Of::Sum ? QVariant::fromValue(tally.sum) : QVariant(tally.count);
        set(page.texts, faces_, core::formatted(value, total.format), total.box, total.style, 1,
            Overlong::Shrink);
    }
    for (size_t at = first; at < page.texts.size(); ++at)
        page.texts[at].baseline += QPointF(page::Margin, top);
}

}  // namespace reports
