// SPDX-License-Identifier: MIT
#include "tests/support/Server.h"

#include <pwd.h>
#include <sys/prctl.h>
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

/// The server refuses to run as root.
const passwd* otherUser() {
    if (geteuid() != 0) return nullptr;
    const passwd* user = getpwnam("postgres");
    if (!user) user = getpwnam("nobody");
    return user;
}

}  // namespace

Server& Server::instance() {
    static Server server;
    return server;
}

Server::Server() {
    if (const passwd* user = otherUser())
        if (chown(QFile::encodeName(folder()), user->pw_uid, user->pw_gid) != 0)
            giveUp(u"Não foi possível preparar a pasta do servidor."_s);
    const QString data = folder_.filePath(u"dados"_s);
    QProcess initdb;
    start(initdb, program(u"initdb"_s),
          {u"-D"_s, data, u"-E"_s, u"UTF8"_s, u"--locale=C.UTF-8"_s, u"-U"_s,
           QString::fromLatin1(User), u"-A"_s, u"trust"_s, u"--no-sync"_s});
    if (!initdb.waitForFinished(60000) || initdb.exitCode() != 0)
        giveUp(QString::fromUtf8(initdb.readAll()));
    QFile access(data + u"/pg_hba.conf"_s);
    if (!access.open(QIODevice::WriteOnly)) giveUp(access.errorString());
    access.write("local all fechado scram-sha-256\nlocal all all trust\n");
    access.close();
    start(server_, program(u"postgres"_s),
          {u"-D"_s, data, u"-k"_s, folder(), u"-c"_s, u"listen_addresses="_s, u"-c"_s,
           u"fsync=off"_s, u"-c"_s, u"lc_messages=C"_s});
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
