// SPDX-License-Identifier: MIT
#pragma once

#include "data/Operations.h"

namespace host {

/// Does what is missing of a posting or annulment that was cut short. Each step is done once, also
/// when another workstation finishes the same one at the same time. Gives in a sentence what was
/// done. Fails as the failing step does; what was done until then stays done.
QString finish(data::Operation operation);

}  // namespace host
