// SPDX-License-Identifier: MIT
#pragma once

#include "host/CommandLine.h"

namespace host {

/// Exit codes of the program.
enum ExitCode { Done = 0, Failed = 1, WrongUse = 2 };

/// Runs what a command line asks for; needs the application object that it asks for too.
int perform(const CommandLine& line);

}  // namespace host
