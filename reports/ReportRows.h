// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"

namespace reports {

/// The row set of the data environment that a report is bound to, opened afresh on the text that
/// its command holds. The caller closes it after a modal preview. Fails as opening a row set does.
ado::RecordsetPtr openReportRows(const QString& name);

/// The same on another text, which the command keeps.
ado::RecordsetPtr openReportRows(const QString& name, const QString& text);

}  // namespace reports
