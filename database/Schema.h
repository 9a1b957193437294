// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QString>

#include "platform/ado/engine/BulkAccess.h"

namespace database {

/// The version of the schema that this program makes and works with. Raised with every change of
/// it, and a file "to<VERSION>.sql" beside the schema then leads there from the version before.
constexpr int SchemaVersion = 2;

/// A file of the folder schema, as it was when the program was built. Fails when it is missing.
QByteArray schemaText(const QString& name);

/// Makes the tables of an empty book, its code lists, and counters that start at 1.
void makeTables(ado::BulkAccess& book);

/// Lets what is first written among the movements of members who left (corrections, opening
/// balances) be numbered far above all others: a movement keeps its id when its member leaves, so
/// that an id names one movement in both tables together. Keys that are higher already stay.
void numberFarAbove(ado::BulkAccess& book);

}  // namespace database
