// SPDX-License-Identifier: MIT
#include "reports/ReportRows.h"

#include "boundary/environment/dtZelmars.h"

namespace reports {

ado::RecordsetPtr openReportRows(const QString& name) {
    environment::dtZelmars& environment = environment::dtZelmars::instance();
    ado::RecordsetPtr rows = environment.Recordsets(name);
    // A preview that nobody waited for leaves it open.
    if (rows->State() != ado::adStateClosed) rows->Close();
    rows->Open(environment.Commands(name).CommandText, environment.SqlServer());
    rows->Requery();
    return rows;
}

}  // namespace reports
