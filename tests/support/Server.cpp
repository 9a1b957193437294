// SPDX-License-Identifier: MIT
#include "tests/support/Server.h"

#include <netinet/in.h>
#include <pwd.h>
#include <sys/prctl.h>
#include <sys/socket.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QStandardPaths>
#include <csignal>
#include <cstdlib>

using namespace Qt::StringLiterals;

namespace support {

namespace {

[[noreturn]] void giveUp(const QString& text) {
    std::fprintf(stderr, "%s\n", qUtf8Printable(text));
    std::exit(1);
}

/// The server's programs lie in a folder for each version.
QString program(const QString& name) {
    const QDir versions(u"/usr/lib/postgresql"_s);
    const QStringList known = versions.entryList(QDir::Dirs | QDir::NoDotAndDotDot);
    for (auto version = known.crbegin(); version != known.crend(); ++version)
        if (const QString path = versions.filePath(*version + u"/bin/"_s + name);
            QFile::exists(path))
            return path;
    const QString path = QStandardPaths::findExecutable(name);
    if (path.isEmpty())
        giveUp(u"Falta o servidor PostgreSQL (%1): instale-o com set-up/packages run test"_s.arg(
            name));
    return path;
}

/// A port of the loopback address that nobody listens on just now.
int freePort() {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t size = sizeof address;
    const int probe = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    auto* const place = reinterpret_cast<sockaddr*>(&address);
    if (bind(probe, place, size) != 0 || getsockname(probe, place, &size) != 0)
        giveUp(u"Não há uma porta livre."_s);
    close(probe);
    return ntohs(address.sin_port);
}

/// The server refuses to run as root.
const passwd* otherUser() {
    if (geteuid() != 0) return nullptr;
    const passwd* user = getpwnam("postgres");
    if (!user) user = getpwnam("nobody");
    return user;
}

}  // namespace

Server& Server::instance() {
    static Server server(Reach::Socket);
    return server;
}

Server& Server::onNetwork() {
    static Server server(Reach::Network);
    return server;
}

Server::Server(Reach reach) {
    if (const passwd* user = otherUser())
        if (chown(QFile::encodeName(folder()), user->pw_uid, user->pw_gid) != 0)
            giveUp(u"Não foi possível preparar a pasta do servidor."_s);
    const QString data = folder_.filePath(u"dados"_s);
    finish(program(u"initdb"_s), {u"-D"_s, data, u"-E"_s, u"UTF8"_s, u"--locale=C.UTF-8"_s, u"-U"_s,
                                  QString::fromLatin1(User), u"-A"_s, u"trust"_s, u"--no-sync"_s});
    QFile access(data + u"/pg_hba.conf"_s);
    if (!access.open(QIODevice::WriteOnly)) giveUp(access.errorString());
    access.write(
        "local all fechado scram-sha-256\nlocal all all trust\n"
        "host all velho all md5\nhost all all all scram-sha-256\n");
    access.close();
    QStringList arguments{u"-D"_s, data, u"-k"_s, folder()};
    QStringList settings{u"fsync=off"_s, u"lc_messages=C"_s};
    if (reach == Reach::Network) {
        for (const QString& name : {u"server"_s, u"foreign"_s}) signCertificate(name);
        port_ = freePort();
        settings << u"listen_addresses=127.0.0.1,127.0.0.2"_s << u"port="_s + port() << u"ssl=on"_s
                 << u"ssl_cert_file="_s + certificate() << u"ssl_key_file="_s + key();
    } else {
        settings << u"listen_addresses="_s;
    }
    for (const QString& setting : settings) arguments << u"-c"_s << setting;
    start(server_, program(u"postgres"_s), arguments);
    QByteArray said;
    while (!said.contains("ready to accept connections")) {
        if (!server_.waitForReadyRead(30000)) giveUp(QString::fromUtf8(said));
        said += server_.readAll();
    }
    // What the server has to say from now on nobody reads; a full pipe would hold it up.
    server_.closeReadChannel(QProcess::StandardOutput);
}

Server::~Server() {
    ::kill(static_cast<pid_t>(process()), SIGQUIT);
    server_.waitForFinished(10000);
}

void Server::signCertificate(const QString& name) {
    finish(u"openssl"_s,
           {u"req"_s, u"-x509"_s, u"-newkey"_s, u"rsa:2048"_s, u"-nodes"_s, u"-days"_s, u"2"_s,
            u"-subj"_s, u"/CN="_s + name, u"-addext"_s, u"subjectAltName=IP:127.0.0.1"_s,
            u"-keyout"_s, key(name), u"-out"_s, certificate(name)});
}

void Server::finish(const QString& path, const QStringList& arguments) {
    QProcess process;
    start(process, path, arguments);
    if (!process.waitForFinished(60000) || process.exitCode() != 0)
        giveUp(QString::fromUtf8(process.readAll()));
}

void Server::start(QProcess& process, const QString& path, const QStringList& arguments) {
    const passwd* user = otherUser();
    process.setProcessChannelMode(QProcess::MergedChannels);
    process.setWorkingDirectory(folder());
    process.setChildProcessModifier([user] {
        if (user && (setgid(user->pw_gid) != 0 || setuid(user->pw_uid) != 0)) _exit(1);
        prctl(PR_SET_PDEATHSIG, SIGQUIT);
    });
    process.start(path, arguments);
    if (!process.waitForStarted()) giveUp(process.errorString());
}

}  // namespace support
