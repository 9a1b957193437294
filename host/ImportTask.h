// SPDX-License-Identifier: MIT
#pragma once

#include "host/CommandLine.h"

namespace host {

/// Brings a file into a book and says what came of each row: all of them with --dry-run, else those
/// that were refused. The status of the program: 0, 1 when rows were refused and nothing was
/// written, 2 when the file could not be brought in at all.
int importIntoBook(const CommandLine& line);

}  // namespace host
