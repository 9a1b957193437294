// SPDX-License-Identifier: MIT
#include "database/Copy.h"

#include <QFile>
#include <QRegularExpression>
#include <QSet>
#include <algorithm>

#include "database/Book.h"
#include "database/Schema.h"
#include "database/Version.h"
#include "platform/ado/postgres/BulkAccess.h"
#include "platform/ado/sqlite/BulkAccess.h"
#include "platform/core/Failure.h"

namespace database {

using namespace Qt::StringLiterals;
using ado::BulkAccess;
using ado::TableShape;
using ado::TableShapes;

namespace {

constexpr qint64 RowsBetweenReports = 5000;

core::Failure refusal(const QString& text) {
    return {core::InvalidCall, text};
}

QByteArray folded(const QByteArray& name) {
    return name.toLower();
}

/// Tables that a new book has rows in: its code lists and counters.
QSet<QByteArray> filledTables() {
    QSet<QByteArray> names;
    static const QRegularExpression insertion(u"INSERT INTO (\\w+)"_s);
    auto found = insertion.globalMatch(QString::fromUtf8(schemaText(u"codes.sql"_s)));
    while (found.hasNext()) names += folded(found.next().captured(1).toLatin1());
    return names;
}

/// A table on both sides, its columns in one order, and what it comes to in the source.
struct Pair {
    TableShape from;
    TableShape into;
    ado::Totals totals;
};

/// The shape with its columns in the order of another one.
TableShape ordered(const TableShape& shape, const TableShape& model) {
    TableShape result{shape.name, {}, {}};
    for (const QByteArray& column : model.columns)
        for (size_t at = 0; at < shape.types.size(); ++at)
            if (folded(shape.columns[at]) == folded(column)) {
                result.columns.push_back(shape.columns[at]);
                result.types.push_back(shape.types[at]);
            }
    return result;
}

QSet<QByteArray> columnsOf(const std::vector<TableShape>& shapes) {
    QSet<QByteArray> names;
    for (const TableShape& shape : shapes)
        for (const QByteArray& column : shape.columns) names += folded(shape.name + '.' + column);
    return names;
}

/// Nothing may be left behind, and nothing made up.
void refuseDifferences(const std::vector<TableShape>& from, const std::vector<TableShape>& into) {
    const QSet<QByteArray> source = columnsOf(from);
    const QSet<QByteArray> target = columnsOf(into);
    const auto refuse = [](const QSet<QByteArray>& lacking, const QString& where) {
        if (lacking.isEmpty()) return;
        QList<QByteArray> names = lacking.values();
        std::sort(names.begin(), names.end());
        throw refusal(u"Os dois livros não têm as mesmas tabelas: %1 falta a coluna %2."_s.arg(
            where, QString::fromUtf8(names.first())));
    };
    refuse(source - target, u"no de destino"_s);
    refuse(target - source, u"no de origem"_s);
}

std::vector<Pair> paired(BulkAccess& from, BulkAccess& into) {
    const std::vector<TableShape> source = from.tables();
    const std::vector<TableShape> target = into.tables();
    refuseDifferences(source, target);
    const TableShapes known(source);
    std::vector<Pair> pairs;
    for (const TableShape& shape : target)
        if (const TableShape* const each = known.find(shape.name))
            pairs.push_back({ordered(*each, shape), shape, {}});
    return pairs;
}

void refuseFilled(BulkAccess& into, const std::vector<Pair>& pairs) {
    const QSet<QByteArray> filled = filledTables();
    for (const Pair& pair : pairs)
        if (!filled.contains(folded(pair.into.name)) && into.totals(pair.into).rows > 0)
            throw refusal(u"O livro de destino não está vazio: a tabela %1 tem linhas."_s.arg(
                QString::fromUtf8(pair.into.name)));
}

void carryRows(BulkAccess& from, BulkAccess& into, const Pair& pair, CopyProgress& progress,
               const CopyListener& listener) {
    progress.table = QString::fromUtf8(pair.into.name);
    progress.rows = 0;
    progress.isTableDone = false;
    from.eachRow(pair.from, [&](const ado::BulkRow& row) {
        into.add(pair.into, row);
        ++progress.allRows;
        if (++progress.rows % RowsBetweenReports == 0) listener(progress);
    });
    into.flush();
    progress.isTableDone = true;
    listener(progress);
}

/// What each side comes to is worked out by its own engine.
void compare(BulkAccess& into, const Pair& pair) {
    if (into.totals(pair.into) == pair.totals) return;
    throw refusal(
        u"A cópia não ficou igual: na tabela %1 o número de linhas ou a soma de um montante "
        "difere."_s.arg(QString::fromUtf8(pair.into.name)));
}

CopySummary carry(BulkAccess& from, BulkAccess& into, const CopyListener& listener) {
    std::vector<Pair> pairs = paired(from, into);
    refuseFilled(into, pairs);
    CopyProgress progress;
    for (Pair& pair : pairs) {
        pair.totals = from.totals(pair.from);
        progress.total += pair.totals.rows;
    }
    for (const Pair& pair : pairs) into.clear(pair.into);
    for (const Pair& pair : pairs) carryRows(from, into, pair, progress, listener);
    CopySummary summary{static_cast<int>(pairs.size()), progress.allRows, 0};
    const std::map<QByteArray, qint64> lastKeys = from.lastKeys();
    for (const Pair& pair : pairs) {
        compare(into, pair);
        summary.sums += static_cast<int>(pair.totals.sums.size());
        if (const auto last = lastKeys.find(folded(pair.from.name)); last != lastKeys.end())
            into.continueAfter(pair.into, last->second);
    }
    return summary;
}

CopySummary copied(const BookPlace& from, const BookPlace& into, const CopyListener& listener) {
    refuseOtherVersion(from);
    if (into.isOnServer()) refuseOtherVersion(into);
    const std::unique_ptr<BulkAccess> source = opened(from);
    source->begin(BulkAccess::Purpose::Reading);
    CopySummary summary;
    if (into.isOnServer()) {
        const std::unique_ptr<BulkAccess> target = opened(into);
        target->begin(BulkAccess::Purpose::Filling);
        summary = carry(*source, *target, listener);
        target->commit();
    } else {
        createBook(into.folder, into.name,
                   [&](BulkAccess& target) { summary = carry(*source, target, listener); });
    }
    return summary;
}

}  // namespace

std::unique_ptr<BulkAccess> openedAnyway(const BookPlace& place) {
    if (place.isOnServer()) return std::make_unique<ado::postgres::BulkAccess>(place.server);
    const QString file = bookFile(place.folder, place.name);
    if (!QFile::exists(file)) throw refusal(u"Não existe o livro «%1»."_s.arg(file));
    return std::make_unique<ado::sqlite::BulkAccess>(file);
}

std::unique_ptr<BulkAccess> opened(const BookPlace& place) {
    std::unique_ptr<BulkAccess> book = openedAnyway(place);
    refuseNewer(*book, place.shown());
    return book;
}

BookPlace BookPlace::parsed(const QString& text) {
    const QString engine = text.section(u':', 0, 0);
    const qsizetype slash = text.lastIndexOf(u'/');
    const QString where = text.mid(engine.size() + 1, slash - engine.size() - 1);
    BookPlace place;
    place.name = text.mid(slash + 1);
    const bool isServer = engine == "postgresql"_L1;
    if (slash < 0 || where.isEmpty() || place.name.isEmpty() ||
        (!isServer && engine != "sqlite"_L1))
        throw refusal(
            u"«%1» não diz onde está um livro; as formas são «sqlite:PASTA/NOME» e "
            "«postgresql:SERVIDOR[:PORTA]/NOME»."_s.arg(text));
    if (isServer) {
        place.server.catalog = place.name;
        place.server.place(where);
    } else {
        place.folder = where;
    }
    return place;
}

QString BookPlace::shown() const {
    return isOnServer() ? server.shown() : bookFile(folder, name);
}

CopySummary copyBook(const BookPlace& from, const BookPlace& into, const CopyListener& listener) {
    try {
        return copied(from, into, listener);
    } catch (const core::Failure& failure) {
        throw core::Failure(failure.number(), u"Nada foi copiado: "_s + failure.text(),
                            failure.code());
    }
}

}  // namespace database
