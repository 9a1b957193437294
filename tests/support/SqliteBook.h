// SPDX-License-Identifier: MIT
#pragma once

#include "tests/support/BookHandle.h"

struct sqlite3;

namespace support {

/// A book file in a folder, copied from one that the process makes once.
class SqliteBook final : public BookHandle {
public:
    SqliteBook(Content content, const QString& folder);
    ~SqliteBook() override;

    QString dataSource() const override { return QStringLiteral("sqlite:") + folder_; }
    QString catalogue() const override { return QStringLiteral("zelmars"); }
    QString user() const override { return QStringLiteral("zelmars"); }
    QList<QStringList> rows(const QString& statements) override;
    QStringList tables() override;
    void hold(const QString& table) override;
    void refuse(const QString& write, const QString& text) override;
    void refuseNoMore() override;

private:
    QString folder_;
    sqlite3* handle_ = nullptr;
};

}  // namespace support
