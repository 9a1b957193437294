// SPDX-License-Identifier: MIT
#include "platform/ado/engine/BulkAccess.h"

#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

QByteArray TableShape::columnList(std::size_t count) const {
    QByteArray list;
    for (std::size_t at = 0; at < count; ++at) list += (at == 0 ? "" : ", ") + columns[at];
    return list;
}

QByteArray TableShape::changeStatement(const char* mark) const {
    QByteArray changes;
    for (std::size_t at = 1; at < columns.size(); ++at)
        changes += (at == 1 ? "" : ", ") + columns[at] + " = " + mark +
                   QByteArray::number(static_cast<qsizetype>(at) + 1);
    return "UPDATE " + name + " SET " + changes + " WHERE " + columns.front() + " = " + mark + '1';
}

void TableShape::failForMissingRow() const {
    throw core::Failure(
        core::DatabaseFailure,
        u"Uma linha da tabela %1 foi apagada entretanto."_s.arg(QString::fromUtf8(name)));
}

TableShapes::TableShapes(std::vector<TableShape> shapes) {
    for (TableShape& shape : shapes) {
        const QByteArray name = shape.name;
        shapes_.emplace(name, std::move(shape));
    }
}

const TableShape* TableShapes::find(const QByteArray& name) const {
    const auto found = shapes_.find(name);
    return found == shapes_.end() ? nullptr : &found->second;
}

const TableShape& TableShapes::at(const QByteArray& name) const {
    if (const TableShape* const shape = find(name)) return *shape;
    throw core::Failure(core::DatabaseFailure,
                        u"Falta no livro a tabela %1."_s.arg(QString::fromUtf8(name)));
}

}  // namespace ado
