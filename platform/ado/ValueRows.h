// SPDX-License-Identifier: MIT
#pragma once

#include <QVariantList>
#include <vector>

#include "platform/ado/engine/Session.h"

namespace ado {

/// A pass over values that a program gives, as if an engine had read them. The values are those of
/// the columns' types; an invalid one is null.
class ValueRows : public Pass {
public:
    ValueRows(std::vector<Column> columns, std::vector<QVariantList> rows)
        : columns_(std::move(columns)), rows_(std::move(rows)) {}

    int columnCount() const override { return static_cast<int>(columns_.size()); }
    const Column& column(int column) const override {
        return columns_[static_cast<std::size_t>(column)];
    }
    int indexOf(QStringView name) const override;
    bool step() override;
    Cell cell(int column) const override;
    RowIdentity identity() const override { return NoRow; }
    void restart() override { at_ = -1; }
    qint64 rowsInAll() override { return static_cast<qint64>(rows_.size()); }
    void release() override { rows_.clear(); }

private:
    std::vector<Column> columns_;
    std::vector<QVariantList> rows_;
    qint64 at_ = -1;
    mutable QByteArray text_;  ///< of the cell asked for last
};

}  // namespace ado
