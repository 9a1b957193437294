// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/engine/EngineTexts.h"

namespace ado::postgres {

/// What the operator reads of a failure: see EngineTexts.h.
/// @param code  SQLSTATE
core::Failure failure(const QString& code, const QString& words);

}  // namespace ado::postgres
