// SPDX-License-Identifier: MIT
#include "host/import/Plan.h"

#include <QHash>
#include <QSet>
#include <algorithm>

#include "host/import/Cells.h"
#include "host/import/Stored.h"
#include "platform/core/Failure.h"
#include "platform/core/Folding.h"
#include "platform/core/Format.h"

using namespace Qt::StringLiterals;

namespace importing {

namespace {

core::Failure refusal(const QString& text) {
    return {core::InvalidCall, text};
}

/// The columns of a file in its order. Fails for one that is unknown, twice there, or missing.
std::vector<Column> columnsOf(const QStringList& head, const Description& description) {
    QStringList known;
    for (const Column& column : description.columns) known << column.heading;
    std::vector<Column> columns;
    for (const QString& heading : head) {
        const auto found = std::find_if(
            description.columns.begin(), description.columns.end(), [&](const Column& column) {
                return core::foldedWords(column.heading) == core::foldedWords(heading);
            });
        if (found == description.columns.end())
            throw refusal(u"A coluna «%1» não existe para %2; há: %3."_s.arg(
                heading, description.title, known.join(u", "_s)));
        for (const Column& before : columns)
            if (before.name == found->name)
                throw refusal(u"A coluna «%1» está duas vezes no ficheiro."_s.arg(heading));
        columns.push_back(*found);
    }
    for (const Column& column : description.columns) {
        const bool isThere = std::any_of(columns.begin(), columns.end(), [&](const Column& each) {
            return each.name == column.name;
        });
        if (!isThere && (column.isRequired || column.holds == Holds::Group))
            throw refusal(u"Falta a coluna «%1»."_s.arg(column.heading));
    }
    return columns;
}

/// Works out what becomes of one row after the other.
class Planner {
public:
    Planner(Plan& plan, const Stored& stored) : plan_(plan), stored_(stored) {
        for (const Column& column : plan.columns)
            sizes_.push_back(definedSize(plan.description->table, column.name));
    }

    PlannedRow planned(const CsvRow& csv) {
        PlannedRow row{.line = csv.line, .key = {}, .detail = {}};
        faults_.clear();
        readCells(csv, row);
        if (faults_.isEmpty()) refuseForKind(row);
        const Stored::Key key = faults_.isEmpty() ? keyOf(row) : Stored::Key();
        if (faults_.isEmpty()) refuseRepeated(key, row);
        const QString group = faults_.isEmpty() && isGroup(row) ? textAt(row, "code") : QString();
        if (!faults_.isEmpty()) {
            row.detail = faults_.join(u"; "_s);
            row.values.clear();
        } else if (const Stored::Row* const before = stored_.find(key)) {
            compare(*before, row);
        } else {
            row.outcome = Outcome::New;
            row.detail = nameOf(row);
        }
        if (!group.isEmpty()) groups_.insert(group);
        return row;
    }

private:
    void note(const Column& column, const QString& cell, const QString& why) {
        faults_ << (cell.isEmpty() ? u"%1 %2"_s.arg(column.heading, why)
                                   : u"%1 «%2» %3"_s.arg(column.heading, cell, why));
    }

    void readCells(const CsvRow& csv, PlannedRow& row) {
        const std::size_t count = plan_.columns.size();
        const auto isExtra = [&](qsizetype at) { return !csv.cells[at].isEmpty(); };
        for (qsizetype at = qsizetype(count); at < csv.cells.size(); ++at)
            if (isExtra(at)) {
                faults_ << u"tem mais células do que colunas"_s;
                break;
            }
        QStringList keys;
        for (std::size_t at = 0; at < count; ++at) {
            const Column& column = plan_.columns[at];
            const QString cell = csv.cells.value(qsizetype(at));
            const auto& key = plan_.description->key;
            if (std::find(key.begin(), key.end(), column.name) != key.end() && !cell.isEmpty())
                keys << cell;
            row.values.push_back(readCell(column, cell, sizes_[at], row));
        }
        row.key = keys.join(u' ');
    }

    ado::BulkValue readCell(const Column& column, const QString& cell, int size, PlannedRow& row) {
        if (cell.isEmpty() && column.isRequired) note(column, {}, u"está vazio"_s);
        if (cell.isEmpty()) return {};
        const ReadCell read = importing::readCell(cell, column.holds, size);
        if (!read.fault.isEmpty()) {
            note(column, cell, read.fault);
            return {};
        }
        if (column.holds == Holds::Member) return memberOf(column, cell);
        if (column.holds == Holds::Group) return groupOf(column, cell, row);
        return read.value;
    }

    ado::BulkValue memberOf(const Column& column, const QString& cell) {
        const std::optional<qint64> member = stored_.member(cell);
        if (!member) {
            note(column, cell, u"não é de nenhum associado"_s);
            return {};
        }
        if (*member == Stored::Several) {
            note(column, cell, u"é de vários associados"_s);
            return {};
        }
        return *member;
    }

    /// A group that comes in the same file gets its key when it is written.
    ado::BulkValue groupOf(const Column& column, const QString& cell, PlannedRow& row) {
        const std::optional<qint64> group = stored_.group(cell);
        if (group && *group != Stored::Several) return *group;
        if (group)
            note(column, cell, u"é o código de vários grupos"_s);
        else if (groups_.contains(cell))
            row.group = cell;
        else
            note(column, cell, u"não é o código de nenhum grupo do livro, nem de um mais acima"_s);
        return {};
    }

    void refuseForKind(const PlannedRow& row) {
        switch (plan_.description->kind) {
            case Kind::Members:
                if (stored_.hasLeft(textAt(row, "no_kor")))
                    faults_ << u"este número é de um associado que saiu"_s;
                break;
            case Kind::Relatives:
                if (!stored_.isPersonCode(textAt(row, "codABC")))
                    faults_ << u"Código «%1» não está na lista dos graus de parentesco"_s.arg(
                        textAt(row, "codABC"));
                break;
            case Kind::Rubrics:
                refuseRubric(row);
                break;
            case Kind::Premiums:
            case Kind::Hospitals:
                break;
        }
    }

    /// A group has ceilings of its own and nothing else; a rubric in a group has to have a share.
    void refuseRubric(const PlannedRow& row) {
        static const QSet<QByteArray> OfGroups{
            "rubrica_id_main", "code", "descrit", "agregado", "socio", "familiar", "total_familia"};
        for (std::size_t at = 0; at < plan_.columns.size(); ++at) {
            const Column& column = plan_.columns[at];
            const bool isThere = row.values[at].index() != 0;
            if (isGroup(row) && isThere && !OfGroups.contains(column.name))
                note(column, {}, u"só se preenche nas rubricas de um grupo"_s);
            if (!isGroup(row) && !isThere && column.name == "percent")
                note(column, {}, u"está vazio"_s);
        }
        const bool hasPercent =
            std::any_of(plan_.columns.begin(), plan_.columns.end(),
                        [](const Column& column) { return column.name == "percent"; });
        if (!isGroup(row) && !hasPercent && !stored_.find(keyOf(row)))
            faults_ << u"falta a coluna «Percentagem», que uma rubrica nova tem de ter"_s;
    }

    bool isGroup(const PlannedRow& row) const {
        return plan_.description->kind == Kind::Rubrics && row.group.isEmpty() &&
               valueAt(row, "rubrica_id_main").index() == 0;
    }

    Stored::Key keyOf(const PlannedRow& row) const {
        Stored::Key key;
        for (const QByteArray& name : plan_.description->key)
            key << (name == "rubrica_id_main" && !row.group.isEmpty()
                        ? u"novo "_s + row.group
                        : shownValue(valueAt(row, name), Holds::Text));
        return key;
    }

    void refuseRepeated(const Stored::Key& key, const PlannedRow& row) {
        if (const auto before = lines_.constFind(key); before != lines_.constEnd())
            faults_ << u"já está na linha %1"_s.arg(*before);
        else
            lines_.insert(key, row.line);
        if (stored_.isAmbiguous(key)) faults_ << u"há mais do que um assim no livro"_s;
    }

    void compare(const Stored::Row& before, PlannedRow& row) {
        QStringList changes;
        for (std::size_t at = 0; at < plan_.columns.size(); ++at) {
            const Column& column = plan_.columns[at];
            if (column.holds == Holds::Member || column.holds == Holds::Group) continue;
            const QString old = shownValue(before.values.at(column.name), column.holds);
            const QString now = shownValue(row.values[at], column.holds);
            if (old != now) changes << u"%1: «%2» → «%3»"_s.arg(column.heading, old, now);
        }
        row.storedKey = before.key;
        row.outcome = changes.isEmpty() ? Outcome::Same : Outcome::Changed;
        row.detail = changes.join(u"; "_s);
        if (changes.isEmpty()) row.values.clear();
    }

    QString nameOf(const PlannedRow& row) const {
        const bool isRubric = plan_.description->kind == Kind::Rubrics;
        return textAt(row, isRubric ? "descrit" : "nome");
    }
    const ado::BulkValue& valueAt(const PlannedRow& row, const QByteArray& name) const {
        static const ado::BulkValue None;
        for (std::size_t at = 0; at < plan_.columns.size(); ++at)
            if (plan_.columns[at].name == name) return row.values[at];
        return None;
    }
    QString textAt(const PlannedRow& row, const QByteArray& name) const {
        return shownValue(valueAt(row, name), Holds::Text);
    }

    Plan& plan_;
    const Stored& stored_;
    std::vector<int> sizes_;
    QStringList faults_;
    QHash<Stored::Key, int> lines_;
    QSet<QString> groups_;  ///< of the rows before
};

}  // namespace

QString outcomeText(Outcome outcome) {
    switch (outcome) {
        case Outcome::New:
            return u"novo"_s;
        case Outcome::Changed:
            return u"alterado"_s;
        case Outcome::Same:
            return u"igual"_s;
        case Outcome::Refused:
            break;
    }
    return u"recusado"_s;
}

qsizetype Plan::count(Outcome outcome) const {
    return std::count_if(rows.begin(), rows.end(),
                         [&](const PlannedRow& row) { return row.outcome == outcome; });
}

QString Plan::summary() const {
    constexpr std::pair<Outcome, const char16_t*> Several[] = {{Outcome::New, u"novos"},
                                                               {Outcome::Changed, u"alterados"},
                                                               {Outcome::Same, u"iguais"},
                                                               {Outcome::Refused, u"recusados"}};
    QStringList parts;
    for (const auto& [outcome, several] : Several) {
        const qsizetype number = count(outcome);
        parts << core::grouped(number) + u' ' +
                     (number == 1 ? outcomeText(outcome) : QString::fromUtf16(several));
    }
    return parts.join(u", "_s);
}

Plan planOf(const CsvText& csv, Kind kind, ado::BulkAccess& book, const GoesOn& goesOn) {
    constexpr std::size_t RowsBetween = 1000;
    Plan plan;
    plan.description = &descriptionOf(kind);
    plan.columns = columnsOf(csv.head, *plan.description);
    const Stored stored(*plan.description, book);
    Planner planner(plan, stored);
    plan.rows.reserve(csv.rows.size());
    for (const CsvRow& row : csv.rows) {
        plan.rows.push_back(planner.planned(row));
        if (plan.rows.size() % RowsBetween != 0) continue;
        if (!goesOn(qsizetype(plan.rows.size()), qsizetype(csv.rows.size()))) {
            plan.rows.clear();
            return plan;
        }
    }
    return plan;
}

}  // namespace importing
