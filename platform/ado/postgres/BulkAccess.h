// SPDX-License-Identifier: MIT
#pragma once

#include <QByteArray>
#include <QString>
#include <unordered_map>

#include "platform/ado/engine/BulkAccess.h"
#include "platform/ado/postgres/Address.h"

struct pg_conn;
struct pg_result;

namespace ado::postgres {

/// A catalogue of a server.
class BulkAccess final : public ado::BulkAccess {
public:
    /// Fails with a text that says what was tried, also for a server that is too old.
    explicit BulkAccess(const Address& address);
    ~BulkAccess() override;
    BulkAccess(const BulkAccess&) = delete;
    BulkAccess& operator=(const BulkAccess&) = delete;

    void execute(const QByteArray& statements) override;
    qint64 number(const QByteArray& query) override;
    QStringList texts(const QByteArray& query) override;
    QByteArray translated(const QByteArray& schema) const override;

    void begin(Purpose purpose) override;
    /// Generated keys go on behind the highest ones that were added, and the server looks at what
    /// it holds, so that the first queries are quick.
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

    // Texts as parts of a statement.
    QByteArray name(const QString& text) const;
    QByteArray literal(const QString& text) const;
    /// A role's password as the server keeps it, so that no log ever sees the password.
    QByteArray encrypted(const QString& password, const QString& role) const;

private:
    /// Rows of a table that the server waits for.
    struct Pending {
        QByteArray lines;  ///< in the server's text form
        std::size_t columns = 0;
    };

    void eachResult(const QByteArray& query, const std::function<void(const pg_result*)>& row);
    void flush(const TableShape& shape, Pending& pending);
    void copyIn(const QByteArray& statement, const QByteArray& lines);
    pg_result* checked(pg_result* result) const;
    [[noreturn]] void fail(const pg_result* result) const;

    pg_conn* connection_ = nullptr;
    Purpose purpose_ = Purpose::Reading;
    std::map<QByteArray, QByteArray> order_;  ///< the column by which a table's rows were added
    std::unordered_map<const TableShape*, Pending> pending_;
    std::unordered_map<const TableShape*, QByteArray> changes_;  ///< their names on the server
};

}  // namespace ado::postgres
