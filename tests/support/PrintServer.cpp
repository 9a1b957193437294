// SPDX-License-Identifier: MIT
#include "tests/support/PrintServer.h"

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QTest>
#include <stdexcept>

using namespace Qt::StringLiterals;

namespace support {

namespace {

const QString Settings = u"Listen %1/socket\nBrowsing Off\nWebInterface No\n"_s;

const QString Files =
    u"ServerRoot %1\nServerBin %1/bin\nCacheDir %1\nStateDir %1\nRequestRoot %1/spool\n"
    "TempDir %1/spool\nAccessLog %1/access.log\nErrorLog %1/error.log\n"_s;

const QString Printers =
    u"<DefaultPrinter Secretaria>\nDeviceURI keep:%1/printed\nState Idle\nAccepting %2\n"
    "</DefaultPrinter>\n"_s;

/// Called with job, user, title, copies, options and the file.
const QString Keeper =
    uR"(#!/bin/sh
[ $# -eq 0 ] && exit 0
to=${DEVICE_URI#keep:}/$1
cat "$6" >"$to.pdf" && printf %s "$3" >"$to.new" && mv "$to.new" "$to.title"
)"_s;

/// Its file stands a moment before anybody listens there.
bool isListening(const QString& socket) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    qstrncpy(address.sun_path, QFile::encodeName(socket).constData(), sizeof address.sun_path);
    const int asking = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    const bool answers =
        connect(asking, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
    close(asking);
    return answers;
}

}  // namespace

PrintServer::PrintServer(Printer printer) {
    QDir(path({})).removeRecursively();
    for (const QString& folder : {u"bin/backend"_s, u"bin/daemon"_s, u"spool"_s, u"printed"_s})
        QDir().mkpath(path(folder));
    QFile::link(u"/usr/lib/cups/daemon/cups-exec"_s, path(u"bin/daemon/cups-exec"_s));
    write(u"cupsd.conf"_s, Settings.arg(path({})));
    write(u"cups-files.conf"_s, Files.arg(path({})));
    write(u"printers.conf"_s,
          Printers.arg(path({}), printer == Printer::Ready ? u"Yes"_s : u"No"_s));
    write(u"bin/backend/keep"_s, Keeper);
    QFile::setPermissions(path(u"bin/backend/keep"_s),
                          QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    server_.setProcessChannelMode(QProcess::ForwardedOutputChannel);
    server_.start(u"/usr/sbin/cupsd"_s,
                  {u"-f"_s, u"-c"_s, path(u"cupsd.conf"_s), u"-s"_s, path(u"cups-files.conf"_s)});
    const bool up = server_.waitForStarted() &&
                    QTest::qWaitFor([this] { return isListening(path(u"socket"_s)); }, 10000);
    if (!up)
        throw std::runtime_error("no print server: set-up/packages run test installs it\n" +
                                 server_.readAllStandardError().toStdString());
}

PrintServer::~PrintServer() {
    server_.terminate();
    if (!server_.waitForFinished(5000)) server_.kill();
    QFile::remove(path(u"socket"_s));
}

QStringList PrintServer::titles(int jobs) {
    const QDir printed(path(u"printed"_s));
    const auto done = [&] { return printed.entryList({u"*.title"_s}, QDir::Files); };
    if (!QTest::qWaitFor([&] { return done().size() >= jobs; }, 10000))
        throw std::runtime_error("the printer got nothing");
    QStringList titles;
    for (const QString& name : done()) {
        QFile title(printed.filePath(name));
        if (title.open(QIODevice::ReadOnly)) titles << QString::fromUtf8(title.readAll());
    }
    return titles;
}

QString PrintServer::file(int number) const {
    return path(u"printed/%1.pdf"_s.arg(number));
}

QString PrintServer::path(const QString& name) const {
    // Fixed for the whole run: the client library remembers where its server is.
    const QString folder = QFileInfo(qEnvironmentVariable("CUPS_SERVER")).path();
    return name.isEmpty() ? folder : folder + u'/' + name;
}

void PrintServer::write(const QString& name, const QString& text) const {
    QFile file(path(name));
    if (!file.open(QIODevice::WriteOnly)) throw std::runtime_error("no folder for a print server");
    file.write(text.toUtf8());
}

}  // namespace support
