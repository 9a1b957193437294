// SPDX-License-Identifier: MIT
#pragma once

#include <QPageSize>
#include <QString>
#include <functional>

#include "platform/ado/Recordset.h"
#include "platform/printing/Pages.h"

class QPainter;
class QPrinter;

/// The ways out of laid-out pages. Failures are core::Failure with a Portuguese text. Files that
/// are written can be read by their owner only.
namespace printing {

/// Paints a page, `unitsPerMillimetre` being the painter's; the page's corner is the origin.
void paint(QPainter& painter, const Pages& pages, int page, double unitsPerMillimetre);

/// A caption as the name of a file, without a suffix and without what file systems do not take.
QString fileName(const QString& caption);

/// Told of each page that is done, counted from 1. False gives up: nothing is written or printed.
using GoesOn = std::function<bool(int done)>;

/// Pages `from`..`to`, counted from 0, on upright paper; what is smaller than A4 takes them
/// smaller.
struct Sheets {
    int from = 0;
    int to = 0;
    QPageSize paper;
};

/// Writes complete pages as PDF, fonts embedded, with their bookmarks as its outline: all of them
/// on A4, or some. False when given up. Fails, leaving no half file, when the file cannot be
/// written.
bool writePdf(const Pages& pages, const QString& file, const GoesOn& goesOn = {});
bool writePdf(const Pages& pages, const Sheets& sheets, const QString& file,
              const GoesOn& goesOn = {});

/// Prints pages `from`..`to`, counted from 0, on a printer that is set up. The job is made whole
/// before the printer hears of it. False when given up. Fails when the job cannot be made or the
/// printer does not take it.
bool print(const Pages& pages, const QPrinter& printer, int from, int to,
           const GoesOn& goesOn = {});

/// Sends complete pages to the default printer, the report's caption as the job's title. Without
/// one, or when it does not take the job, writes a PDF into the person's documents folder (or,
/// where that cannot be written, the home folder or the folder for temporary files) beside what is
/// there already, and says so in a box that names the file. False when given up.
bool printUnasked(const Pages& pages, const GoesOn& goesOn = {});

/// The rows as a text for spreadsheets (CsvFile.h). One line with the columns that the report
/// shows, one for each detail row; of a report with groups the group's columns stand first. Fails,
/// leaving no half file, when the file cannot be written.
void writeCsv(const Report& report, const ado::RecordsetPtr& rows, const QString& file);

}  // namespace printing
