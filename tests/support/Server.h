// SPDX-License-Identifier: MIT
#pragma once

#include <QProcess>
#include <QString>
#include <QTemporaryDir>

namespace support {

/// A PostgreSQL server of this test run alone: a cluster in a temporary folder, reached through a
/// socket there, gone with the program however that ends. Where no server is installed the run
/// fails with a text that says so.
class Server {
public:
    static Server& instance();

    /// The folder of the socket, which is the host's name.
    QString folder() const { return folder_.path(); }
    qint64 process() const { return server_.processId(); }
    /// Who owns the cluster and every book on it.
    static constexpr auto User = "dono";

private:
    Server();
    ~Server();
    void start(QProcess& process, const QString& program, const QStringList& arguments);

    QTemporaryDir folder_;
    QProcess server_;
};

}  // namespace support
