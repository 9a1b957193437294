// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "platform/ado/Recordset.h"
#include "platform/printing/Pages.h"
#include "platform/printing/Report.h"

namespace printing {

/// Turns rows into pages, a stretch at a time, so that the first page can be seen while the last
/// is still to come. Everything stays in the caller's thread, as row sets do.
class Layout {
public:
    /// Starts at the first row. Fails with NoSuchItem and the name when the report names a column
    /// or chapter that the rows do not have.
    Layout(const Report& report, const ado::RecordsetPtr& rows);
    ~Layout();

    /// Goes on for about so many milliseconds (or to the end when negative). True when complete.
    /// Fails as reading a row does.
    bool go(int milliseconds);
    /// How much of the rows is laid out, 0..1.
    double share() const;
    /// True when all pages are laid out.
    bool isComplete() const { return pages_->isComplete(); }
    /// The pages laid out so far; those who hold them see the following ones come.
    const std::shared_ptr<Pages>& pages() const { return pages_; }

private:
    struct Implementation;
    std::shared_ptr<Pages> pages_;
    std::unique_ptr<Implementation> d;
};

}  // namespace printing
