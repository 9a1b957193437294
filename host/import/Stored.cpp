// SPDX-License-Identifier: MIT
#include "host/import/Stored.h"

#include "host/import/Cells.h"

using namespace Qt::StringLiterals;

namespace importing {

namespace {

QString text(const ado::BulkValue& value) {
    return shownValue(value, Holds::Text);
}

qint64 number(const ado::BulkValue& value) {
    const auto* whole = std::get_if<qint64>(&value);
    return whole ? *whole : 0;
}

void insert(QHash<QString, qint64>& all, const QString& name, qint64 key) {
    const auto before = all.constFind(name);
    all.insert(name, before == all.constEnd() ? key : Stored::Several);
}

}  // namespace

void eachRow(ado::BulkAccess& book, const QByteArray& table, const std::vector<QByteArray>& columns,
             const std::function<void(const ado::BulkRow&)>& take) {
    const ado::TableShapes shapes(book.tables());
    const ado::TableShape& whole = shapes.at(table);
    ado::TableShape shape{whole.name, {}, {}};
    for (const QByteArray& wanted : columns)
        for (std::size_t at = 0; at < whole.columns.size(); ++at)
            if (whole.columns[at].compare(wanted, Qt::CaseInsensitive) == 0) {
                shape.columns.push_back(whole.columns[at]);
                shape.types.push_back(whole.types[at]);
            }
    book.eachRow(shape, take);
}

Stored::Stored(const Description& description, ado::BulkAccess& book) {
    readRows(description, book);
    if (description.kind == Kind::Members)
        eachRow(book, "tbSocios_Inactivos", {"no_kor"},
                [&](const ado::BulkRow& row) { left_.insert(text(row[0])); });
    if (description.kind == Kind::Relatives || description.kind == Kind::Premiums)
        eachRow(book, "tbSocios", {"socio_id", "no_kor"},
                [&](const ado::BulkRow& row) { insert(members_, text(row[1]), number(row[0])); });
    if (description.kind == Kind::Relatives)
        eachRow(book, "tbSocios_Familias_CodeABC", {"descrit"},
                [&](const ado::BulkRow& row) { personCodes_.insert(text(row[0])); });
    if (description.kind == Kind::Rubrics)
        eachRow(book, "tbZelmar_Plafonds", {"rubrica_id", "rubrica_id_main", "code"},
                [&](const ado::BulkRow& row) {
                    if (row[1].index() == 0) insert(groups_, text(row[2]), number(row[0]));
                });
}

void Stored::readRows(const Description& description, ado::BulkAccess& book) {
    std::vector<QByteArray> columns{description.generatedKey.isEmpty() ? description.key.front()
                                                                       : description.generatedKey};
    for (const Column& column : description.columns) columns.push_back(column.name);
    eachRow(book, description.table, columns, [&](const ado::BulkRow& values) {
        Row row{number(values[0]), {}};
        for (std::size_t at = 1; at < columns.size(); ++at) row.values[columns[at]] = values[at];
        Key key;
        for (const QByteArray& name : description.key) key << text(row.values[name]);
        if (rows_.contains(key)) ambiguous_.insert(key);
        rows_.insert(key, row);
    });
}

const Stored::Row* Stored::find(const Key& key) const {
    const auto row = rows_.constFind(key);
    return row == rows_.constEnd() ? nullptr : &*row;
}

std::optional<qint64> Stored::found(const QHash<QString, qint64>& all, const QString& text) {
    const auto key = all.constFind(text);
    return key == all.constEnd() ? std::nullopt : std::optional(*key);
}

}  // namespace importing
