// SPDX-License-Identifier: MIT
#pragma once

#include "database/Copy.h"
#include "host/CommandLine.h"

/// The commands that make books and carry them over. Failures are core::Failure.
namespace host {

/// The book that a line names, else that of the settings, with who enters it: the user of the
/// settings, or the administrator when the line names a book or him.
database::BookPlace placeOf(const CommandLine& line, bool asAdministrator);

void makeBook(const CommandLine& line);
void makeServerBook(const CommandLine& line);
/// Shows how far the copying has come. Ctrl+C ends it as a failure does: nothing stays in the
/// target.
void copyBook(const CommandLine& line);
/// Proves the book; says what is wrong, line by line.
/// @return 0 for a book without faults, 1 for one with, 2 when it cannot be looked at
int checkBook(const CommandLine& line);
void backUpBook(const CommandLine& line);
void restoreBook(const CommandLine& line);
/// Brings the book to the version of this program and says what was done.
void upgradeBook(const CommandLine& line);

}  // namespace host
