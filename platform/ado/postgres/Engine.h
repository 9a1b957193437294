// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/engine/Engine.h"

namespace ado::postgres {

/// Books on a server, a catalogue each.
const Engine& engine();

}  // namespace ado::postgres
