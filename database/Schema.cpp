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
    // A movement keeps its id when its member leaves. What is first written among those of members
    // who left (corrections, opening balances) is numbered far above, so that an id names one
    // movement in both tables together.
    constexpr qint64 FarAbove = 1'000'000'000;
    const QByteArray schema =
        schemaText(u"book.sql"_s).replace("{movement}", schemaText(u"movement.sql"_s).trimmed());
    book.execute(book.translated(schema));
    book.execute(schemaText(u"codes.sql"_s));
    book.continueAfter(ado::TableShapes(book.tables()).at("tbZelmar_Movimentos_Inactivos"),
                       FarAbove);
}

}  // namespace database
