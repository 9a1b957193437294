// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/SqliteSession.h"

namespace ado {

/// A statement being stepped on a reader of its own.
class SqlitePass final : public Pass {
public:
    /// `withIdentity`: the statement's first column is the row identity.
    SqlitePass(std::shared_ptr<SqliteSession> session, const QByteArray& text, bool withIdentity);
    ~SqlitePass() override;

    int columnCount() const override { return columns_; }
    const Column& column(int column) const override;
    int indexOf(QStringView name) const override;
    bool step() override;
    Cell cell(int column) const override;
    RowIdentity identity() const override {
        return first_ == 0 ? 0 : sqlite3_column_int64(statement_.get(), 0);
    }
    void restart() override;
    void release() override;

private:
    std::shared_ptr<SqliteSession> session_;
    std::unique_ptr<SqliteHandle> reader_;
    SqliteStatement statement_;
    int first_;  ///< the statement's column that is this pass's column 0
    int columns_;
    qint64 steps_ = 0;
    bool held_ = false;  ///< a transaction keeps the rows as they were at the start
    mutable std::vector<Column> described_;
};

}  // namespace ado
