// SPDX-License-Identifier: MIT
#pragma once

#include <sqlite3.h>

#include <QByteArray>
#include <QString>

namespace benchmarks {

/// The engine without anything around it, with the settings that a book is opened with.
class Bare {
public:
    explicit Bare(const QString& file);
    ~Bare();
    Bare(const Bare&) = delete;
    Bare& operator=(const Bare&) = delete;

    /// Prepares, steps through and finalises one statement; reads `column` of its first row.
    double run(const QByteArray& statement, int column = 0);
    sqlite3* handle() const { return handle_; }

private:
    sqlite3* handle_ = nullptr;
};

}  // namespace benchmarks
