// SPDX-License-Identifier: MIT
#pragma once

#include "tests/support/BookHandle.h"

struct pg_conn;

namespace support {

/// A catalogue of its own on the run's server, copied from one that the process makes once. The
/// handle is its owner's; `user` is an operator, who may do what the screens do and nothing else.
class PostgresBook final : public BookHandle {
public:
    explicit PostgresBook(Content content);
    ~PostgresBook() override;

    QString dataSource() const override;
    QString catalogue() const override { return catalogue_; }
    QString user() const override;
    QList<QStringList> rows(const QString& statements) override;
    QStringList tables() override;
    void hold(const QString& table) override;
    void refuse(const QString& write, const QString& text) override;
    void refuseNoMore() override;

private:
    QString catalogue_;
    pg_conn* handle_ = nullptr;
};

}  // namespace support
