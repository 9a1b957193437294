// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/sqlite/Session.h"

namespace ado::sqlite {

/// A statement being stepped on a reader of its own.
class Pass final : public ado::Pass {
public:
    /// `withIdentity`: the row identity stands before the statement's columns.
    Pass(std::shared_ptr<Session> session, const Query& statement, bool withIdentity);
    ~Pass() override;

    int columnCount() const override { return columns_; }
    const Column& column(int column) const override;
    int indexOf(QStringView name) const override;
    bool step() override;
    Cell cell(int column) const override;
    RowIdentity identity() const override {
        return first_ == 0 ? 0 : sqlite3_column_int64(statement_, 0);
    }
    void restart() override;
    qint64 rowsInAll() override;
    void release() override;

private:
    void describeAnew();
    void hold();

    std::shared_ptr<Session> session_;
    std::shared_ptr<Handle> reader_;  ///< outlives the query, also when others step on it
    std::unique_ptr<SqliteQuery> query_;
    sqlite3_stmt* statement_ = nullptr;  ///< of the query
    int first_;                          ///< the statement's column that is this pass's column 0
    int columns_ = 0;
    qint64 steps_ = 0;
    bool leased_ = true;  ///< nobody else steps on the reader
    bool held_ = false;   ///< a transaction keeps the rows as they were at the start
};

}  // namespace ado::sqlite
