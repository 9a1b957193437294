// SPDX-License-Identifier: MIT
#pragma once

#include "host/CommandLine.h"

namespace host {

/// The command that makes the letters, declarations or extracts of all members. Failures are
/// core::Failure.
void makeDocuments(const CommandLine& line);

}  // namespace host
