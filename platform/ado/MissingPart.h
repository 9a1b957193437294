// SPDX-License-Identifier: MIT
#pragma once

#include "platform/core/Failure.h"

namespace ado {

/// What to tell of a failed statement: where the book lacks a table or a column that it names, what
/// was tried and what the engine said; any other failure as it is. Number and code stay.
core::Failure explained(const core::Failure& failure, const QString& tried);

}  // namespace ado
