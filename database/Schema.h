// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QString>

#include "platform/ado/engine/BulkAccess.h"

namespace database {

/// A file of the folder schema, as it was when the program was built. Fails when it is missing.
QByteArray schemaText(const QString& name);

/// Makes the tables of an empty book, its code lists, and counters that start at 1.
void makeTables(ado::BulkAccess& book);

}  // namespace database
