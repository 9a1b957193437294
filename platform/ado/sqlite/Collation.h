// SPDX-License-Identifier: MIT
#pragma once

struct sqlite3;

namespace ado::sqlite {

/// Makes the collation known to a handle by which texts sort as a Portuguese reader expects; texts
/// that sort alike stand in the order of their bytes, so only equal texts are equal.
void installCollation(sqlite3* db);

}  // namespace ado::sqlite
