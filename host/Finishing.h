// SPDX-License-Identifier: MIT
#pragma once

#include "data/Operations.h"

namespace host {

/// Does what is missing of a posting or annulment that was cut short, each step once, whoever else
/// is at it. Gives in a sentence what was done. Fails with what the failing step fails with; what
/// was done until then stays done.
QString finish(data::Operation operation);

}  // namespace host
