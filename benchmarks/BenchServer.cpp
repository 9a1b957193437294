// SPDX-License-Identifier: MIT
#include "benchmarks/BenchServer.h"

#include <unistd.h>

#include <QDir>
#include <QProcess>
#include <stdexcept>

using namespace Qt::StringLiterals;

namespace benchmarks {

namespace {

/// Runs a program, which may leave another one running; as another user than root where it refuses
/// that one.
void run(QStringList command, bool asRoot = false) {
    if (geteuid() == 0 && !asRoot)
        command = QStringList{u"runuser"_s, u"-u"_s, u"postgres"_s, u"--"_s} + command;
    QProcess process;
    process.setProcessChannelMode(QProcess::MergedChannels);
    process.setStandardOutputFile(QProcess::nullDevice());
    process.setWorkingDirectory(QDir::rootPath());
    process.start(command.takeFirst(), command);
    if (!process.waitForFinished(120000) || process.exitCode() != 0)
        throw std::runtime_error("PostgreSQL: " + process.program().toStdString() + ' ' +
                                 process.arguments().join(u' ').toStdString());
}

/// The server's programs lie in a folder for each version.
QString program(const QString& name) {
    QProcess tell;
    tell.start(u"pg_config"_s, {u"--bindir"_s});
    tell.waitForFinished();
    return QString::fromLocal8Bit(tell.readAllStandardOutput()).trimmed() + u'/' + name;
}

}  // namespace

const BenchServer& BenchServer::instance() {
    static const BenchServer server;
    return server;
}

BenchServer::BenchServer()
    // Beside the books, whose folder only its owner can enter.
    : folder_(QDir::current().absoluteFilePath(u"build/bench/server"_s)) {
    if (!QDir(folder_).exists(u"PG_VERSION"_s)) {
        QDir().mkpath(folder_);
        if (geteuid() == 0) run({u"chown"_s, u"postgres"_s, folder_}, true);
        run({program(u"initdb"_s), u"-D"_s, folder_, u"-E"_s, u"UTF8"_s, u"--locale=C.UTF-8"_s,
             u"-U"_s, QString::fromLatin1(User), u"-A"_s, u"trust"_s});
    }
    // Also when a run that was cut short left the server running.
    run({program(u"pg_ctl"_s), u"-D"_s, folder_, u"-w"_s, u"-s"_s, u"-o"_s,
         u"-k %1 -c listen_addresses= -c fsync=off"_s.arg(folder_), u"restart"_s});
}

BenchServer::~BenchServer() {
    try {
        run({program(u"pg_ctl"_s), u"-D"_s, folder_, u"-s"_s, u"-m"_s, u"fast"_s, u"stop"_s});
    } catch (const std::exception&) {
        // A server that does not stop is restarted by the next run.
    }
}

}  // namespace benchmarks
