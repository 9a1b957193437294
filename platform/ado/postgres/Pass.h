// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/postgres/Session.h"

namespace ado::postgres {

/// A statement whose rows are here at once when they are few, else come in batches from a cursor on
/// a reader of its own.
class Pass final : public ado::Pass {
public:
    /// `withIdentity`: the row identity stands before the statement's columns.
    Pass(std::shared_ptr<Session> session, const Query& statement, bool withIdentity);
    ~Pass() override { release(); }

    int columnCount() const override { return static_cast<int>(columns_.size()); }
    const Column& column(int column) const override {
        return columns_[static_cast<std::size_t>(column)];
    }
    int indexOf(QStringView name) const override;
    bool step() override;
    Cell cell(int column) const override;
    RowIdentity identity() const override;
    void restart() override;
    qint64 rowsInAll() override;
    void release() override;

private:
    /// Rows of the first batch; a set with fewer is here with one round trip.
    static constexpr int FirstRows = 64;
    static constexpr int LaterRows = 1000;

    /// True when all rows are in the batch now.
    bool isShort(const Query& statement);
    void fetchFirst(const QByteArray& before);
    /// True when no row comes behind the batch.
    bool isWhole() const { return !reader_ || (!first_ && count() < LaterRows); }
    int count() const { return PQntuples(batch_.get()); }
    void describeColumns();

    std::shared_ptr<Session> session_;
    std::shared_ptr<Handle> reader_;  ///< none any more when all rows are here
    QByteArray declare_;
    bool withIdentity_;
    Result batch_;
    qint64 before_ = 0;  ///< rows of the batches before this one
    int row_ = -1;       ///< within the batch
    bool first_ = true;  ///< the batch is the first one
    std::vector<Column> columns_;
    std::vector<int> places_;  ///< of the columns within the batch
};

}  // namespace ado::postgres
