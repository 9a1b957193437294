// SPDX-License-Identifier: MIT
#include "reports/ReportRows.h"

#include "boundary/environment/dtZelmars.h"

namespace reports {

ado::RecordsetPtr openReportRows(const QString& name) {
    return openReportRows(name, environment::dtZelmars::instance().Commands(name).CommandText);
}

ado::RecordsetPtr openReportRows(const QString& name, const QString& text) {
    environment::dtZelmars& environment = environment::dtZelmars::instance();
    ado::RecordsetPtr rows = environment.Recordsets(name);
    // A modeless preview of the same report may have left it open.
    if (rows->State() != ado::adStateClosed) rows->Close();
    environment.Commands(name).CommandText = text;
    // Intentional: not queried again. All rows are read in this moment already, and a second
    // reading would make whoever waits for a long report wait twice.
    rows->Open(text, environment.SqlServer());
    return rows;
}

void printOrShow(const printing::DataReport& report, const QString& text, bool isPrinted) {
    const ado::RecordsetPtr rows = openReportRows(report.design().dataMember, text);
    if (isPrinted)
        report.PrintReport(rows);
    else
        report.Show(rows, printing::DataReport::Wait::Modal);
    rows->Close();
}

}  // namespace reports
