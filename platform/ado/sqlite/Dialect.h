// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/dialect/Translation.h"

namespace ado::sqlite {

/// The row identity of every table.
inline constexpr auto Identity = "_rowid_";
/// The collation by which texts sort as a Portuguese reader expects.
inline constexpr auto Collation = "portuguese";

/// The query in SQLite's language; see Translation.
QString translate(const Query& query, Schema& schema, bool withIdentity);

}  // namespace ado::sqlite
