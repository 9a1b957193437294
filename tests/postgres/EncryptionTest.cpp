// SPDX-License-Identifier: MIT
// Who gets a password. What counts as remote is told by the text alone, so that "127.1", which is
// the loopback address in an unusual form, stands for any other machine here.
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>

#include "database/ServerBook.h"
#include "platform/ado/Connection.h"
#include "platform/ado/postgres/BulkAccess.h"
#include "platform/ado/postgres/Handle.h"
#include "tests/support/Failure.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;
using support::failureOf;
using support::Server;

namespace {

/// The script beside this file: it lets everybody ask and wants the password.
class FalseServer {
public:
    FalseServer(const QString& question, bool hasCertificate) {
        QStringList arguments{QStringLiteral(FALSE_SERVER), question};
        if (hasCertificate)
            arguments << Server::onNetwork().certificate(u"foreign"_s)
                      << Server::onNetwork().key(u"foreign"_s);
        process_.setProcessChannelMode(QProcess::ForwardedErrorChannel);
        process_.start(u"python3"_s, arguments);
        port_ = QString::fromLatin1(line());
    }
    ~FalseServer() {
        process_.kill();
        process_.waitForFinished();
    }
    FalseServer(const FalseServer&) = delete;
    FalseServer& operator=(const FalseServer&) = delete;

    QString port() const { return port_; }
    /// All that one caller said.
    std::string heard() {
        QByteArray all;
        for (QByteArray next = line(); next != "end" && !next.isEmpty(); next = line())
            all += next + ' ';
        return all.trimmed().toStdString();
    }

private:
    QByteArray line() {
        while (!process_.canReadLine())
            if (!process_.waitForReadyRead(20000)) return {};
        return process_.readLine().trimmed();
    }

    QProcess process_;
    QString port_;
};

class Encryption : public testing::Test {
protected:
    void SetUp() override { qputenv("HOME", home_.path().toUtf8()); }
    void TearDown() override { qputenv("HOME", homeBefore_); }

    /// Puts a root certificate where the client library looks for one.
    void trust(const QString& certificate) {
        QDir(home_.path()).mkpath(u".postgresql"_s);
        const QString place = home_.filePath(u".postgresql/root.crt"_s);
        QFile::remove(place);
        ASSERT_TRUE(QFile::copy(certificate, place));
    }

    QTemporaryDir home_;

private:
    QByteArray homeBefore_ = qgetenv("HOME");
};

/// Opens a book as a workstation does.
ado::ConnectionPtr entered(const QString& place, const QString& catalogue, const QString& user) {
    auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString =
        u"User ID=%1;Password=segredo;Initial Catalog=%2;Data Source=postgresql:%3"_s.arg(
            user, catalogue, place);
    connection->Open();
    return connection;
}

ado::postgres::Address addressOf(const QString& place, const QString& catalogue) {
    ado::postgres::Address address;
    address.catalog = catalogue;
    address.place(place);
    return address;
}

/// Makes a book as the administrator does.
void made(const QString& place, const QString& catalogue) {
    auto server = addressOf(place, catalogue);
    server.user = QString::fromLatin1(Server::User);
    server.password = u"segredo"_s;
    database::initBook(server, {u"balcao"_s, u"segredo"_s}, false);
}

TEST_F(Encryption, IsForEverythingThatIsNotThisMachine) {
    const struct {
        QString host;
        bool isLocal;
    } cases[] = {
        {u"/run/postgresql"_s, true},
        {u"@abstracto"_s, true},
        {u"localhost"_s, true},
        {u"LocalHost"_s, true},
        {u"127.0.0.1"_s, true},
        {u"127.255.3.4"_s, true},
        {u"::1"_s, true},
        {u"0:0:0:0:0:0:0:1"_s, true},
        {u""_s, false},
        {u"servidor"_s, false},
        {u"localhost.exemplo.pt"_s, false},
        {u"127.0.0.1.exemplo.pt"_s, false},
        {u"127.1"_s, false},
        {u"128.0.0.1"_s, false},
        {u"192.168.1.10"_s, false},
        {u"0.0.0.0"_s, false},
        {u"::"_s, false},
        {u"::2"_s, false},
        {u"::ffff:127.0.0.1"_s, false},
        {u"fe80::1"_s, false},
        {u"/run/postgresql,servidor"_s, false},
        {u"localhost,servidor"_s, false},
    };
    for (const auto& row : cases)
        EXPECT_EQ(ado::postgres::isLocalHost(row.host), row.isLocal) << qPrintable(row.host);
}

TEST_F(Encryption, IsGivenUpByOneWordOnly) {
    const struct {
        QString source;
        bool isReadable;
    } cases[] = {
        {u"postgresql:servidor"_s, false},
        {u"postgresql:servidor?tls=no"_s, true},
        {u"PostgreSQL:servidor:5433?tls=no"_s, true},
        {u"postgresql:[fe80::1]:5433?tls=no"_s, true},
        {u"postgresql:localhost?tls=no"_s, false},
        {u"postgresql:/run/postgresql?tls=no"_s, false},
        {u"postgresql:servidor:x?tls=no"_s, false},
        {u"sqlite:/livro?tls=no"_s, false},
    };
    for (const auto& row : cases)
        EXPECT_EQ(ado::isReadableOnTheWay(row.source), row.isReadable) << qPrintable(row.source);
    for (const auto& place : {u"servidor?"_s, u"servidor?tls=yes"_s, u"servidor?sslmode=disable"_s,
                              u"servidor?tls=no?tls=no"_s})
        EXPECT_TRUE(failureOf([&] { entered(place, u"livro"_s, u"x"_s); })
                        .text()
                        .contains(u"só «?tls=no»"_s))
            << qPrintable(place);
    const auto server = addressOf(u"servidor:5433?tls=no"_s, u"livro"_s);
    EXPECT_EQ(server.dataSource(), u"postgresql:servidor:5433?tls=no"_s);
}

TEST_F(Encryption, GivesNoPasswordToAServerThatAsksForIt) {
    const struct {
        QString host;
        QString question;
        bool hasCertificate;
        const char* heard;
    } cases[] = {
        // Nobody but this machine listens: that the password comes shows that it would be heard.
        {u"127.0.0.1"_s, u"clear"_s, false, "start answer b'segredo\\x00'"},
        {u"127.1"_s, u"clear"_s, false, ""},
        {u"127.1"_s, u"clear"_s, true, "tls start"},
        {u"127.1"_s, u"md5"_s, true, "tls start"},
        {u"127.1"_s, u"late"_s, true, "tls start"},
        {u"127.1?tls=no"_s, u"clear"_s, false, "start"},
        {u"127.1?tls=no"_s, u"md5"_s, false, "start"},
        {u"127.1?tls=no"_s, u"late"_s, false, "start"},
        {u"127.1?tls=no"_s, u"part"_s, false, "start"},
    };
    for (const auto& row : cases) {
        FalseServer server(row.question, row.hasCertificate);
        const QString place =
            row.host.section(u'?', 0, 0) + u':' + server.port() +
            (row.host.contains(u'?') ? u'?' + row.host.section(u'?', 1) : QString());
        SCOPED_TRACE(qPrintable(place + u' ' + row.question));
        EXPECT_NE(failureOf([&] { entered(place, u"livro"_s, u"balcao"_s); }).text(), QString());
        EXPECT_EQ(server.heard(), row.heard);
        EXPECT_NE(failureOf([&] { made(place, u"livro"_s); }).text(), QString());
        EXPECT_EQ(server.heard(), row.heard);
    }
}

TEST_F(Encryption, ReachesAServerThatProvesItself) {
    Server& server = Server::onNetwork();
    ado::postgres::BulkAccess administration({.host = server.folder(),
                                              .port = server.port(),
                                              .user = QString::fromLatin1(Server::User),
                                              .password = {},
                                              .catalog = u"postgres"_s});
    administration.execute(
        "ALTER ROLE dono PASSWORD 'segredo'; SET password_encryption = 'md5';"
        "CREATE ROLE velho LOGIN PASSWORD 'segredo'");
    const QString encrypted = u"127.1:"_s + server.port();
    const QString plain = encrypted + u"?tls=no"_s;
    made(encrypted, u"cifrado"_s);
    made(plain, u"claro"_s);

    const auto isEncrypted = [&](const QString& place) {
        const auto connection = entered(place, u"cifrado"_s, u"balcao"_s);
        return administration.number(
                   "SELECT ssl FROM pg_stat_ssl JOIN pg_stat_activity USING (pid) "
                   "WHERE usename = 'balcao' ORDER BY backend_start DESC LIMIT 1") == 1;
    };
    EXPECT_TRUE(isEncrypted(encrypted));
    EXPECT_FALSE(isEncrypted(plain));
    // Whoever still has his password in the old form does not get in from another machine.
    for (const QString& place : {encrypted, plain})
        EXPECT_NE(failureOf([&] { entered(place, u"postgres"_s, u"velho"_s); }).text(), QString());

    trust(server.certificate());
    EXPECT_TRUE(isEncrypted(encrypted));
    // The same machine under a name for which the certificate was not made.
    EXPECT_TRUE(failureOf([&] { isEncrypted(u"127.2:"_s + server.port()); })
                    .text()
                    .contains(u"does not match host name"_s));
    trust(server.certificate(u"foreign"_s));
    for (const auto& enter : {std::function([&] { isEncrypted(encrypted); }),
                              std::function([&] { made(encrypted, u"terceiro"_s); })})
        EXPECT_TRUE(failureOf(enter).text().contains(u"certificate verify failed"_s));
}

}  // namespace
