// SPDX-License-Identifier: MIT
#pragma once

#include "host/CommandLine.h"

namespace host {

/// Exit codes of the program.
enum ExitCode { Done = 0, Failed = 1, WrongUse = 2 };

/// Runs what a command line asks for; needs the application object that it asks for too.
int perform(const CommandLine& line);

/// Registers, or withdraws, the component and its companions that lie beside the program. Fails
/// with a core::Failure that names the first one that cannot be.
void registerComponents(bool undo);

}  // namespace host
