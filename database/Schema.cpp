// SPDX-License-Identifier: MIT
#include "database/Schema.h"

#include <QFile>

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

// A static library's resource is linked in only when it is asked for, and that from outside any
// namespace.
static void loadSchema() {
    Q_INIT_RESOURCE(schema);
}

namespace database {

QByteArray schemaText(const QString& name) {
    loadSchema();
    QFile file(u":/zelmars/schema/"_s + name);
    if (!file.open(QIODevice::ReadOnly))
        throw core::Failure(core::InvalidCall, u"Falta no programa o ficheiro %1."_s.arg(name));
    return file.readAll();
}

void makeTables(ado::BulkAccess& book) {
    const QByteArray schema =
        schemaText(u"book.sql"_s).replace("{movement}", schemaText(u"movement.sql"_s).trimmed());
    book.execute(book.translated(schema));
    book.execute(
        schemaText(u"codes.sql"_s).replace("{version}", QByteArray::number(SchemaVersion)));
    numberFarAbove(book);
}

void numberFarAbove(ado::BulkAccess& book) {
    constexpr qint64 FarAbove = 1'000'000'000;
    const ado::TableShapes shapes(book.tables());
    const ado::TableShape& left = shapes.at("tbZelmar_Movimentos_Inactivos");
    if (book.lastKeys()[left.name.toLower()] < FarAbove) book.continueAfter(left, FarAbove);
}

}  // namespace database
