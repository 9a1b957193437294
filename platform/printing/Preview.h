// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "platform/ado/Recordset.h"
#include "platform/forms/Form.h"
#include "platform/printing/Report.h"

namespace printing {

/// The preview of a report: pages as they will be printed, one at a time or one below the other;
/// zoom, find, print, PDF, CSV; all of it by keyboard. The first page shows as soon as it is laid
/// out; the others follow while the window is in use. Closing it stops the layout.
///
/// Its objectName is the report's name. It keeps the rows; when somebody closes or requeries them
/// before all pages are there, it keeps the pages that it has and says so.
///
/// A failure of the rows or of the layout is shown in a box; the pages laid out until then stay,
/// but cannot be printed or saved: their totals would be missing.
class Preview : public forms::Form {
    Q_OBJECT
public:
    /// Fails as Layout does when the rows lack what the report names.
    Preview(const Report& report, const ado::RecordsetPtr& rows);
    ~Preview() override;

private:
    struct Implementation;
    std::unique_ptr<Implementation> d;
};

}  // namespace printing
