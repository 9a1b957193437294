// SPDX-License-Identifier: MIT
#include "platform/printing/PreviewSource.h"

#include "platform/core/Failure.h"

using namespace Qt::StringLiterals;

namespace printing {

PreviewSource::PreviewSource(const Report& report, const ado::RecordsetPtr& rows)
    : report_(report),
      rows_(rows),
      layout_(std::make_unique<Layout>(report, rows)),
      pages_(layout_->pages()) {
    const auto take = [this] { taken_ = true; };
    connect(rows.get(), &ado::Recordset::closed, this, take);
    connect(rows.get(), &ado::Recordset::opened, this, take);
}

const ado::RecordsetPtr& PreviewSource::rows() const {
    if (taken_ || !rows_)
        throw core::Failure(core::ObjectClosed,
                            u"As linhas desta listagem já foram fechadas. Abra-a de novo."_s);
    return rows_;
}

void PreviewSource::go(int milliseconds) {
    if (!layout_) return;
    try {
        (void)rows();
        if (layout_->go(milliseconds)) layout_.reset();
    } catch (...) {
        layout_.reset();
        throw;
    }
}

void PreviewSource::stop() {
    layout_.reset();
    rows_.reset();
}

}  // namespace printing
