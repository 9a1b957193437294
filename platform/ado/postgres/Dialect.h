// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/dialect/Translation.h"

namespace ado::postgres {

/// The row identity that tables without a key of one number have; no set shows it.
inline constexpr auto HiddenIdentity = "_linha";

/// The query in the server's language; see Translation.
QString translate(const Query& query, Schema& schema, bool withIdentity);

}  // namespace ado::postgres
