// SPDX-License-Identifier: MIT
#pragma once

#include "database/Copy.h"

/// Brings books that older programs made to the schema of this one.
namespace database {

/// Told in a sentence of each step that is done; what it throws ends the work.
using UpgradeListener = std::function<void(const QString& done)>;

/// Where the backup of a book goes when nobody names a file: beside the book, or in the folder of a
/// server's administrator, with the version and the moment in its name.
QString upgradeBackupFile(const BookPlace& place, int version);

/// Keeps the book in the file as a backup, and then brings it up to date, in one transaction during
/// which nobody else writes to it; then it has the schema, and on a server the rights, of a new
/// book. Its rows stay as they are. A book that is up to date is left alone, without a backup.
///
/// Fails, also when the program is killed, with the book as it was: when somebody else has it open,
/// when the backup cannot be made, on a server when the place does not name its administrator. A
/// backup that was made stays.
/// @return the version that the book had
int bringUpToDate(const BookPlace& place, const QString& backup, const UpgradeListener& listener);

}  // namespace database
