// SPDX-License-Identifier: MIT
#pragma once

#include "database/Copy.h"

/// Which version of the schema a book has, and whether this program can work with it.
namespace database {

/// The version of a book's schema; 1 for one that does not tell it.
int schemaVersion(ado::BulkAccess& book);

/// Says that a book or a backup is newer than this program.
QString newerText(int version, const QString& shown);
/// Fails when the book's schema is newer than this program. What an older one does not have yet may
/// be read past it.
void refuseNewer(ado::BulkAccess& book, const QString& shown);
/// Why this program does not work with a book of that version, for people; empty when it does.
QString whyUnfit(int version, const BookPlace& place);
/// Fails unless the book has the schema of this program.
void refuseOtherVersion(const BookPlace& place);

}  // namespace database
