// SPDX-License-Identifier: MIT
#include "host/import/Import.h"

#include <QFile>
#include <algorithm>

#include "host/import/Stored.h"
#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace importing {

namespace {

using ado::BulkAccess;
using ado::TableShape;

/// SQLSTATE of what the user of a server may not do.
constexpr auto MissingRight = "42501"_L1;

CsvText readFile(const QString& name) {
    QFile file(name);
    if (!file.open(QIODevice::ReadOnly))
        throw core::Failure(core::InvalidCall,
                            u"Não foi possível ler «%1»: %2"_s.arg(name, file.errorString()));
    return readCsv(file.readAll());
}

/// Writes the rows of a plan.
class Writer {
public:
    Writer(BulkAccess& book, const Plan& plan, const GoesOn& goesOn)
        : book_(book), plan_(plan), goesOn_(goesOn) {
        added_.name = plan.description->table;
        changed_.name = added_.name;
        changed_.columns.push_back(plan.description->generatedKey.isEmpty()
                                       ? plan.description->key.front()
                                       : plan.description->generatedKey);
        for (std::size_t at = 0; at < plan.columns.size(); ++at) {
            added_.columns.push_back(plan.columns[at].name);
            if (isKey(plan.columns[at])) continue;
            changed_.columns.push_back(plan.columns[at].name);
            changing_.push_back(at);
        }
    }

    /// False when given up.
    bool write() {
        // New groups first, so that their rubrics can be told whose they are.
        for (const bool isBehindGroup : {false, true}) {
            const QHash<QString, qint64> groups =
                isBehindGroup ? newGroups() : QHash<QString, qint64>();
            for (const PlannedRow& row : plan_.rows)
                if (row.group.isEmpty() != isBehindGroup && !write(row, groups)) return false;
            book_.flush();
        }
        return true;
    }

private:
    bool isKey(const Column& column) const {
        const auto& key = plan_.description->key;
        return std::find(key.begin(), key.end(), column.name) != key.end();
    }

    bool write(const PlannedRow& row, const QHash<QString, qint64>& groups) {
        constexpr qsizetype RowsBetween = 1000;
        if (row.outcome == Outcome::New) add(row, groups);
        if (row.outcome == Outcome::Changed) change(row);
        return ++done_ % RowsBetween != 0 || goesOn_(done_, qsizetype(plan_.rows.size()));
    }

    void add(const PlannedRow& row, const QHash<QString, qint64>& groups) {
        ado::BulkRow values = row.values;
        if (!row.group.isEmpty())
            for (std::size_t at = 0; at < plan_.columns.size(); ++at)
                if (plan_.columns[at].holds == Holds::Group) values[at] = groups.value(row.group);
        book_.add(added_, values);
    }

    void change(const PlannedRow& row) {
        ado::BulkRow values{row.storedKey};
        for (const std::size_t at : changing_) values.push_back(row.values[at]);
        if (values.size() > 1) book_.change(changed_, values);
    }

    /// The keys that new groups were given, by their codes.
    QHash<QString, qint64> newGroups() {
        QHash<QString, qint64> groups;
        for (const PlannedRow& row : plan_.rows)
            if (!row.group.isEmpty()) groups.insert(row.group, 0);
        if (groups.isEmpty()) return groups;
        const std::vector<QByteArray> columns{"rubrica_id", "rubrica_id_main", "code"};
        eachRow(book_, plan_.description->table, columns, [&](const ado::BulkRow& row) {
            const auto* code = std::get_if<QByteArray>(&row[2]);
            const auto* key = std::get_if<qint64>(&row[0]);
            if (row[1].index() == 0 && code && key && groups.contains(QString::fromUtf8(*code)))
                groups[QString::fromUtf8(*code)] = *key;
        });
        return groups;
    }

    BulkAccess& book_;
    const Plan& plan_;
    const GoesOn& goesOn_;
    TableShape added_;
    TableShape changed_;
    std::vector<std::size_t> changing_;  ///< positions of changed_'s columns in the plan
    qsizetype done_ = 0;
};

bool agree(const Plan& one, const Plan& other) {
    return std::equal(one.rows.begin(), one.rows.end(), other.rows.begin(), other.rows.end(),
                      [](const PlannedRow& a, const PlannedRow& b) {
                          return a.line == b.line && a.outcome == b.outcome && a.key == b.key &&
                                 a.detail == b.detail;
                      });
}

std::optional<Result> imported(const Wish& wish, const database::BookPlace& place, Refused refused,
                               const Plan* seen, const GoesOn& goesOn) {
    const CsvText csv = readFile(wish.file);
    const std::unique_ptr<BulkAccess> book = database::opened(place);
    book->begin(BulkAccess::Purpose::Importing);
    Result result{planOf(csv, wish.kind, *book, goesOn)};
    if (result.plan.rows.size() < csv.rows.size()) return {};
    if (seen && !agree(*seen, result.plan))
        throw core::Failure(core::InvalidCall,
                            u"O livro ou o ficheiro mudou entretanto. Veja de novo o que vai "
                            "acontecer."_s);
    const bool mayWrite = refused == Refused::LeaveOut || result.plan.count(Outcome::Refused) == 0;
    if (!mayWrite || !result.plan.hasWork()) return result;
    if (!Writer(*book, result.plan, goesOn).write()) return {};
    book->commit();
    result.isWritten = true;
    return result;
}

}  // namespace

std::optional<Plan> preview(const Wish& wish, const database::BookPlace& place,
                            const GoesOn& goesOn) {
    const CsvText csv = readFile(wish.file);
    const std::unique_ptr<BulkAccess> book = database::opened(place);
    book->begin(BulkAccess::Purpose::Reading);
    Plan plan = planOf(csv, wish.kind, *book, goesOn);
    if (plan.rows.size() < csv.rows.size()) return {};
    return plan;
}

std::optional<Result> importFile(const Wish& wish, const database::BookPlace& place,
                                 Refused refused, const Plan* seen, const GoesOn& goesOn) {
    try {
        return imported(wish, place, refused, seen, goesOn);
    } catch (const core::Failure& failure) {
        const QString why =
            failure.code() == MissingRight
                ? u"importar é para os gestores do livro: peça-o a quem cuida do servidor."_s
                : failure.text();
        throw core::Failure(failure.number(), u"Nada foi importado: "_s + why, failure.code());
    }
}

}  // namespace importing
