// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"

namespace reports {

/// The row set of the data environment that a report is bound to, opened afresh on the text that
/// its command holds. The caller closes it after a modal showing. Fails as opening a row set does.
ado::RecordsetPtr openReportRows(const QString& name);

}  // namespace reports
