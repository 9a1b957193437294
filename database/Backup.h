// SPDX-License-Identifier: MIT
#pragma once

#include "database/Copy.h"

/// A whole book in one file, and back. Failures are core::Failure, and leave everything as it was.
namespace database {

/// True when a backup can be made of a book at that place: of one on a server only where the
/// server's own programs are installed.
bool canBackUp(const BookPlace& book);

/// Keeps the book as it stands now, of whatever version up to this program's, while others may go
/// on writing. Never writes over a file.
void backUpBook(const BookPlace& book, const QString& file);

/// Puts a backup in the place of the book, once it is proved to be whole. On a server the catalogue
/// has to be there, and the place names its administrator. The book then has the version of the
/// backup, which may be an older one; one newer than this program is refused.
/// @param replace  whether a book that has members or movements is to be lost
void restoreBook(const QString& file, const BookPlace& book, bool replace);

/// The version of the schema in a backup; 1 when it does not tell it.
int versionInBackup(const QString& file, const BookPlace& book);

/// Who else has the book open, for people: one entry a program or connection.
QStringList othersIn(const BookPlace& book);

}  // namespace database
