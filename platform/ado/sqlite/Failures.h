// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/engine/EngineTexts.h"

namespace ado::sqlite {

/// What the operator reads of a failure: see EngineTexts.h.
/// @param code  extended result code
core::Failure failure(int code, const QString& words);

}  // namespace ado::sqlite
