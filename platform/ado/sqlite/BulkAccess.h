// SPDX-License-Identifier: MIT
#pragma once

#include <unordered_map>

#include "platform/ado/engine/BulkAccess.h"
#include "platform/ado/sqlite/Handle.h"

namespace ado::sqlite {

/// A book's file.
class BulkAccess final : public ado::BulkAccess {
public:
    /// Opens an existing file; never makes one.
    explicit BulkAccess(const QString& file);
    ~BulkAccess() override;
    BulkAccess(const BulkAccess&) = delete;
    BulkAccess& operator=(const BulkAccess&) = delete;

    void execute(const QByteArray& statements) override { handle_.execute(statements.constData()); }
    qint64 number(const QByteArray& query) override;
    QStringList texts(const QByteArray& query) override;
    QByteArray translated(const QByteArray& schema) const override { return schema; }

    void begin(Purpose purpose) override;
    void commit() override;

    std::vector<TableShape> tables() override;
    void eachRow(const TableShape& shape, const std::function<void(const BulkRow&)>& row) override;
    std::set<QByteArray> parts() override;
    Totals totals(const TableShape& shape) override;
    std::map<QByteArray, qint64> lastKeys() override;

    void add(const TableShape& shape, const BulkRow& row) override;
    void change(const TableShape& shape, const BulkRow& row) override;
    void clear(const TableShape& shape) override;
    void flush() override;
    void continueAfter(const TableShape& shape, qint64 lastKey) override;

private:
    bool step(sqlite3_stmt* statement);
    void run(const QByteArray& text, const BulkRow& row);

    Handle handle_;
    Purpose purpose_ = Purpose::Reading;
    // The statements for the rows of a shape.
    std::unordered_map<const TableShape*, QByteArray> insertions_;
    std::unordered_map<const TableShape*, QByteArray> changes_;
};

}  // namespace ado::sqlite
