// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <memory>

#include "platform/ado/Recordset.h"
#include "platform/printing/Layout.h"

namespace printing {

/// Where the pages of a preview come from: the rows, which stay open, and the layout that is under
/// way. When somebody else closes or requeries the rows, no page can follow.
class PreviewSource : public QObject {
public:
    /// Fails as Layout does.
    PreviewSource(const Report& report, const ado::RecordsetPtr& rows);

    const Report& report() const { return report_; }
    const std::shared_ptr<Pages>& pages() const { return pages_; }
    /// Fails with ObjectClosed when they are not those of the pages any more.
    const ado::RecordsetPtr& rows() const;

    /// True while more pages are to come.
    bool isAtWork() const { return layout_ != nullptr; }
    /// Goes on for about so many milliseconds. A failure ends the work; the pages stay.
    void go(int milliseconds);
    /// Ends the work and lets go of the rows.
    void stop();

private:
    const Report report_;
    ado::RecordsetPtr rows_;
    std::unique_ptr<Layout> layout_;
    const std::shared_ptr<Pages> pages_;
    bool taken_ = false;
};

}  // namespace printing
