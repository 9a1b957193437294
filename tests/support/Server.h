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
    /// Another one, which also listens on 127.0.0.1 and 127.0.0.2, there with passwords (scram, and
    /// md5 for the role "velho") and with a certificate for 127.0.0.1 that it has signed itself.
    /// Beside that lies "foreign", somebody else's.
    static Server& onNetwork();

    /// The folder of the socket, which is the host's name.
    QString folder() const { return folder_.path(); }
    qint64 process() const { return server_.processId(); }
    /// Who owns the cluster and every book on it.
    static constexpr auto User = "dono";
    /// Of the one on the network.
    QString port() const { return QString::number(port_); }
    QString certificate(const QString& name = QStringLiteral("server")) const {
        return folder_.filePath(name + QStringLiteral(".crt"));
    }
    QString key(const QString& name = QStringLiteral("server")) const {
        return folder_.filePath(name + QStringLiteral(".key"));
    }

private:
    enum class Reach { Socket, Network };
    explicit Server(Reach reach);
    ~Server();
    void start(QProcess& process, const QString& program, const QStringList& arguments);
    void signCertificate(const QString& name);
    void finish(const QString& program, const QStringList& arguments);

    QTemporaryDir folder_;
    int port_ = 0;
    QProcess server_;
};

}  // namespace support
