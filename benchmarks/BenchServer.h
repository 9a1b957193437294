// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace benchmarks {

/// A PostgreSQL server with the settings of a fresh installation, except that it waits for no disk,
/// as copies in memory do not. Its books stay for the next run; after a power cut they are to be
/// made anew. It is reached by the socket in its folder and ends with the program.
class BenchServer {
public:
    static const BenchServer& instance();

    const QString& folder() const { return folder_; }
    static constexpr auto User = "dono";

private:
    BenchServer();
    ~BenchServer();

    QString folder_;
};

}  // namespace benchmarks
