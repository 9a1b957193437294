// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "benchmarks/Books.h"
#include "platform/ado/Recordset.h"
#include "platform/printing/Report.h"

namespace benchmarks {

/// Milliseconds from opening the rows until the first page is painted.
double timedFirstPage(const printing::Report& design,
                      const std::function<ado::RecordsetPtr()>& open);

/// Milliseconds in which the bare engine, on a connection of its own, gives all rows of the
/// queries. Fails when they have none.
double timedBareRows(const Book& book, const QByteArrayList& queries);

}  // namespace benchmarks
