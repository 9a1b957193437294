// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

#include "platform/ado/Recordset.h"
#include "platform/printing/Report.h"

namespace printing {

/// A report about to be shown or printed: a copy of its declaration whose captions may be set, and
/// the rows.
class DataReport {
public:
    explicit DataReport(const Report& design);

    /// The declaration with the captions set so far.
    const Report& design() const { return report_; }

    /// Sets the text of a label of a section, both found by name; it is printed letter for letter.
    /// Fails with NoSuchItem and the name when there is none.
    void setCaption(const QString& section, const QString& label, const QString& caption);

    /// Lays all pages out and sends them to the default printer, without a dialog, the report's
    /// caption as the job's title. Without a printer they become a PDF in the person's documents
    /// folder, and a box names the file. Rows are taken from the first on; the row set stays open.
    /// What takes longer than half a second can be given up; a box then says so.
    void PrintReport(const ado::RecordsetPtr& rows) const;

    enum class Wait { Modal, Modeless };
    /// Opens the preview. Modal returns when it has closed; modeless returns at once and the
    /// preview keeps the rows.
    void Show(const ado::RecordsetPtr& rows, Wait wait) const;

private:
    /// False when the person gave up.
    bool isPrinted(const ado::RecordsetPtr& rows) const;

    Report report_;
};

}  // namespace printing
