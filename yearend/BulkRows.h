// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "platform/ado/Recordset.h"

/// Row sets of the two bulk jobs, which go through whole tables row by row.
namespace yearend {

/// Called at each row, so that the windows get their turn.
using Serve = std::function<void()>;

/// Opens a query on the connection `MSAccess`.
ado::RecordsetPtr openBulk(const QString& query, ado::CursorType cursor = ado::adOpenUnspecified,
                           ado::LockType lock = ado::adLockUnspecified);

/// Deletes what a query over one table gives, row by row from the first.
void empty(const QString& query, ado::CursorType cursor, const Serve& serve);

/// Rows of a set, of which at least one is there; the first one is current then.
int countFromLast(ado::Recordset& rows);

}  // namespace yearend
