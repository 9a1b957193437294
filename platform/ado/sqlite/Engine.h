// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/engine/Engine.h"

namespace ado::sqlite {

/// Books in a file each: FOLDER/catalog.db.
const Engine& engine();

}  // namespace ado::sqlite
