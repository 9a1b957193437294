// SPDX-License-Identifier: MIT
#pragma once

#include "host/CommandLine.h"

namespace host {

/// The command that makes a file for the bank. Says what cannot go, and what was sent before.
/// Failures are core::Failure.
/// @return false when no file was made for one of these reasons
bool makeBankFile(const CommandLine& line);

}  // namespace host
