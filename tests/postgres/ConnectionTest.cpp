// SPDX-License-Identifier: MIT
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <QElapsedTimer>
#include <csignal>

#include "ServerBook.h"

using namespace Qt::StringLiterals;

namespace {

class Connections : public ServerBook {
protected:
    /// Stops everything on the server that works for this book; it answers no more.
    void signalBackends(int signal) {
        const QStringList processes =
            exec(
                u"SELECT coalesce(string_agg(pid::text, ' '), '') FROM pg_stat_activity "
                u"WHERE datname = current_database() AND pid <> pg_backend_pid()"_s)
                .split(u' ', Qt::SkipEmptyParts);
        EXPECT_FALSE(processes.isEmpty());
        for (const QString& process : processes) kill(process.toInt(), signal);
        stopped = processes;
    }
    void wake() const {
        for (const QString& process : stopped) kill(process.toInt(), SIGCONT);
    }
    QStringList stopped;
};

core::Failure failureOfOpening(const QString& text) {
    ado::Connection connection;
    connection.ConnectionString = text;
    return failureOf([&] { connection.Open(); });
}

}  // namespace

TEST_F(Connections, SayWhatWasTriedAndNeverThePassword) {
    exec(u"CREATE ROLE fechado LOGIN PASSWORD 'outro'"_s);
    const QString host = support::Server::instance().folder();
    const auto at = [&](const QString& source) {
        return QString(connectionString(catalog, u"dono"_s))
            .replace(u"postgresql:"_s + host, source);
    };
    const struct {
        QString text;
        QString part;
    } cases[] = {
        {connectionString(catalog, u"fechado"_s), u"password authentication failed"_s},
        {connectionString(u"nada"_s, u"dono"_s), u"database \"nada\" does not exist"_s},
        {connectionString(catalog, u"ninguem"_s), u"role \"ninguem\" does not exist"_s},
        {at(u"postgresql:"_s + host + u"/nada"_s), u"No such file or directory"_s},
        {at(u"postgresql:"_s + host + u":5999"_s), u".s.PGSQL.5999"_s},
        {at(u"postgresql:"_s + host + u":99999"_s), u"a porta «99999» não existe"_s},
        {at(u"postgresql:localhost:1"_s), u"Connection refused"_s},
        {at(u"postgresql:"_s), u"«postgresql:SERVIDOR[:PORTA]»"_s},
    };
    for (const auto& row : cases) {
        const core::Failure failure = failureOfOpening(row.text);
        EXPECT_TRUE(failure.text().startsWith(u"Não foi possível abrir"_s)) << failure.what();
        EXPECT_TRUE(failure.text().contains(row.part)) << failure.what();
        EXPECT_FALSE(failure.text().contains(u"segredo"_s)) << failure.what();
    }
    EXPECT_TRUE(failureOfOpening(connectionString(u"nada"_s, u"dono"_s))
                    .text()
                    .contains(u"«postgresql:%1/nada» como «dono»"_s.arg(host)));
}

TEST_F(Connections, GiveUpOnAServerThatNeverAnswers) {
    const QString host = support::Server::instance().folder();
    sockaddr_un address{AF_UNIX, {}};
    const QByteArray path = host.toUtf8() + "/.s.PGSQL.5998";
    std::copy(path.begin(), path.end(), address.sun_path);
    const int silent = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    ASSERT_EQ(bind(silent, reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
    ASSERT_EQ(listen(silent, 1), 0);
    QElapsedTimer waited;
    waited.start();
    const core::Failure failure = failureOfOpening(QString(connectionString(catalog, u"dono"_s))
                                                       .replace(host, host + u":5998"_s)
                                                       .replace(u"=15"_s, u"=1"_s));
    close(silent);
    EXPECT_TRUE(failure.text().contains(u"não respondeu em 1 segundos"_s)) << failure.what();
    EXPECT_LT(waited.elapsed(), 5000);
}

TEST_F(Connections, ThatWereCutAreMadeAnew) {
    fill(200);
    const auto passing = open(u"select * from tbMov"_s, connection);
    exec(
        u"SELECT pg_terminate_backend(pid, 5000) FROM pg_stat_activity WHERE datname = "
        u"current_database() AND pid <> pg_backend_pid()"_s);
    const core::Failure failure = failureOf([&] { passing->MoveLast(); });
    EXPECT_TRUE(failure.text().contains(u"perdeu-se"_s)) << failure.what();
    EXPECT_EQ(failure.code(), u"57P01"_s);
    EXPECT_EQ(open(u"select * from tbMov where id=1"_s, connection)->Collect(u"nome"_s), u"n1"_s);
}

TEST_F(Connections, DoNotHangOnAServerThatStopsAnswering) {
    fill(1);
    const auto own = connect(1);
    const auto rows = open(u"select * from tbMov"_s, own, ado::adLockOptimistic);
    rows->setCollect(u"nome"_s, u"a"_s);
    rows->Update();
    signalBackends(SIGSTOP);
    rows->setCollect(u"nome"_s, u"b"_s);
    QElapsedTimer waited;
    waited.start();
    EXPECT_TRUE(failureOf([&] { rows->Update(); }).text().contains(u"não respondeu"_s));
    EXPECT_TRUE(failureOf([&] { open(u"select 1"_s, own); }).text().contains(u"não respondeu"_s));
    EXPECT_LT(waited.elapsed(), 10000);
    wake();
    rows->Update();
    EXPECT_EQ(exec(u"SELECT nome FROM tbMov"_s), u"b"_s);
}

TEST_F(Connections, StopAStatementThatTakesTooLong) {
    const auto own = connect(1);
    EXPECT_EQ(failureOf([&] { open(u"select pg_sleep(60)"_s, own); }).code(), u"57014"_s);
    EXPECT_EQ(open(u"select 1 as um"_s, own)->value(0), QVariant(1));
}

TEST_F(Connections, SeeTablesMadeLaterAndAltered) {
    EXPECT_EQ(failureOf([&] { open(u"select * from tbNova"_s, connection); }).text(),
              u"relation \"tbnova\" does not exist"_s);
    exec(u"CREATE TABLE tbNova (nome text, _linha bigint GENERATED ALWAYS AS IDENTITY)"_s);
    const auto rows = open(u"select * from tbNova"_s, connection);
    rows->AddNew();
    rows->setCollect(u"nome"_s, u"x"_s);
    rows->Update();
    exec(u"ALTER TABLE tbNova ADD COLUMN nota varchar(7) DEFAULT 'n'"_s);
    EXPECT_EQ(open(u"select * from tbNova"_s, connection, ado::adLockReadOnly)->Collect(u"nota"_s),
              u"n"_s);
}
