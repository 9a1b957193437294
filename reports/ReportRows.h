// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"
#include "platform/printing/DataReport.h"

namespace reports {

/// The row set of the data environment that a report is bound to, opened afresh on the text that
/// its command holds. The caller closes it after a modal preview. Fails as opening a row set does.
ado::RecordsetPtr openReportRows(const QString& name);

/// The same on another text, which the command keeps.
ado::RecordsetPtr openReportRows(const QString& name, const QString& text);

/// Opens the rows that the report is bound to on another text, prints it unasked or shows it until
/// the person closes the preview, and closes the rows.
void printOrShow(const printing::DataReport& report, const QString& text, bool isPrinted);

}  // namespace reports
