// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

#include "platform/ado/Recordset.h"
#include "platform/printing/Pages.h"
#include "platform/printing/Report.h"

class QWidget;

/// The ways out of a preview, with the questions that a person answers first. Each gives a line
/// that says what was done, empty when the person gave up. Pages must be complete. Failures are
/// those of Output.h.
namespace printing {

/// Asks for printer, pages and copies. Without any printer the pages go where reports that nobody
/// is asked about go.
/// @param current  the page in sight, from 0
QString printAsking(QWidget* parent, const Pages& pages, int current);

/// Asks for the file, by default named for the report in the documents folder or where the last
/// one was put, and before an older one is written over.
QString savePdfAsking(QWidget* parent, const Pages& pages);
/// The same for the rows as a text for spreadsheets; what they hold is told in Output.h.
QString exportCsvAsking(QWidget* parent, const Report& report, const ado::RecordsetPtr& rows);

/// The file for such a text that the person wants; empty for none.
QString askCsvFile(QWidget* parent, const QString& caption);
/// The line that says where something was put.
QString written(const QString& file);

}  // namespace printing
