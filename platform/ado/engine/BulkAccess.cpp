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
