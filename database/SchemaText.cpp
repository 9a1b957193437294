// SPDX-License-Identifier: MIT
#include "database/SchemaText.h"

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

}  // namespace database
