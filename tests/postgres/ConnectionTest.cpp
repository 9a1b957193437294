// SPDX-License-Identifier: MIT
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <QElapsedTimer>
#include <csignal>
#include <thread>

#include "tests/ado/SmallBook.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;

namespace {

class Connections : public SmallBook {
protected:
    /// Stops everything on the server that works for this book; it answers no more.
    void signalBackends(int signal) {
        const QStringList processes =
            book.text(
                    u"SELECT pid FROM pg_stat_activity "
                    "WHERE datname = current_database() AND pid <> pg_backend_pid()"_s)
                .split(u'\n', Qt::SkipEmptyParts);
        EXPECT_FALSE(processes.isEmpty());
        for (const QString& process : processes) kill(process.toInt(), signal);
        stopped = processes;
    }
    void wake() const {
        for (const QString& process : stopped) kill(process.toInt(), SIGCONT);
    }
    /// Ends everything on the server that works for this book.
    void cut() {
        book.exec(
            u"SELECT pg_terminate_backend(pid, 5000) FROM pg_stat_activity WHERE datname = "
            "current_database() AND pid <> pg_backend_pid()"_s);
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
    book.exec(u"CREATE ROLE fechado LOGIN PASSWORD 'outro'"_s);
    const QString host = support::Server::instance().folder();
    // The book's own text, with something else in it.
    const auto with = [&](const QString& what, const QString& other) {
        return book.connectionString()
            .replace(u"Password="_s, u"Password=segredo"_s)
            .replace(what, other);
    };
    const auto at = [&](const QString& source) { return with(u"postgresql:"_s + host, source); };
    const auto as = [&](const QString& user) { return with(book.user(), user); };
    const QString elsewhere = with(book.catalogue(), u"nada"_s);
    const struct {
        QString text;
        QString part;
    } cases[] = {
        {as(u"fechado"_s), u"O nome de utilizador ou a palavra-passe não estão certos"_s},
        {as(u"fechado"_s), u"password authentication failed"_s},
        {elsewhere, u"O servidor não tem este livro"_s},
        {at(u"postgresql:nao.ha.invalid"_s), u"O servidor «nao.ha.invalid» não foi encontrado"_s},
        {elsewhere, u"database \"nada\" does not exist"_s},
        {as(u"ninguem"_s), u"role \"ninguem\" does not exist"_s},
        {at(u"postgresql:"_s + host + u"/nada"_s), u"No such file or directory"_s},
        {at(u"postgresql:"_s + host + u":5999"_s), u".s.PGSQL.5999"_s},
        {at(u"postgresql:"_s + host + u":99999"_s), u"a porta «99999» não existe"_s},
        {at(u"postgresql:localhost:1"_s), u"O servidor não aceita a ligação"_s},
        {at(u"postgresql:localhost:1"_s), u"Connection refused"_s},
        {at(u"postgresql:[::1]:1"_s), u"«postgresql:[::1]:1/"_s},
        {at(u"postgresql:"_s), u"«postgresql:SERVIDOR[:PORTA]»"_s},
    };
    for (const auto& row : cases) {
        const core::Failure failure = failureOfOpening(row.text);
        EXPECT_TRUE(failure.text().startsWith(u"Não foi possível abrir"_s)) << failure.what();
        EXPECT_TRUE(failure.text().contains(row.part)) << failure.what();
        EXPECT_FALSE(failure.text().contains(u"segredo"_s)) << failure.what();
    }
    EXPECT_TRUE(failureOfOpening(elsewhere).text().contains(
        u"«postgresql:%1/nada» como «%2»"_s.arg(host, book.user())));
}

TEST_F(Connections, AskForTheSettingsThatTheyRelyOn) {
    for (const auto& setting :
         {u"extra_float_digits = 0"_s, u"default_transaction_isolation = 'repeatable read'"_s})
        book.exec(u"ALTER DATABASE \"%1\" SET %2"_s.arg(book.catalogue(), setting));
    book.exec(u"INSERT INTO tbMov(simples) VALUES (12345.67); INSERT INTO tbConta VALUES (1)"_s);
    const auto own = connect();
    EXPECT_EQ(open(u"select * from tbMov"_s, own)->Collect(u"simples"_s), QVariant(12345.67F));
    // Whoever waited for a row reads what was stored meanwhile.
    const auto held = open(u"select * from tbConta"_s, own, ado::adLockPessimistic);
    EXPECT_EQ(held->value(0), 1);
    std::thread waiting([&] {
        const auto rows = open(u"select * from tbConta"_s, connect(30), ado::adLockPessimistic);
        EXPECT_EQ(rows->value(0), 2);
    });
    const auto isWaited = [&] {
        return book.text(u"SELECT count(*) FROM pg_locks WHERE NOT granted"_s) != u"0"_s;
    };
    while (!isWaited()) std::this_thread::yield();
    held->setValue(0, 2);
    held->Update();
    waiting.join();
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
    const core::Failure failure = failureOfOpening(
        book.connectionString().replace(host, host + u":5998"_s).replace(u"=15"_s, u"=1"_s));
    close(silent);
    EXPECT_TRUE(failure.text().contains(u"não respondeu em 1 segundos"_s)) << failure.what();
    EXPECT_LT(waited.elapsed(), 5000);
}

TEST_F(Connections, ThatWereCutAreMadeAnew) {
    fill(200);
    const auto passing = open(u"select * from tbMov"_s, connection);
    cut();
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
    const QString text = failureOf([&] { rows->Update(); }).text();
    EXPECT_TRUE(text.contains(u"não respondeu"_s)) << qPrintable(text);
    EXPECT_TRUE(text.contains(u"procure-a antes de repetir"_s)) << qPrintable(text);
    EXPECT_TRUE(failureOf([&] { open(u"select 1"_s, own); }).text().contains(u"não respondeu"_s));
    EXPECT_LT(waited.elapsed(), 10000);
    wake();
    rows->Update();
    EXPECT_EQ(book.text(u"SELECT nome FROM tbMov"_s), u"b"_s);
}

TEST_F(Connections, SayWhichRightIsMissing) {
    book.exec(u"REVOKE ALL ON tbHosp FROM \"%1\", PUBLIC"_s.arg(book.user()));
    const core::Failure failure =
        failureOf([&] { open(u"select * from tbHosp"_s, connection, ado::adLockReadOnly); });
    EXPECT_EQ(failure.text(),
              u"Este utilizador não tem direito a isto; nada foi gravado. Peça-o a quem cuida do "
              "livro.\n\nPormenores: permission denied for table tbhosp"_s);
    EXPECT_EQ(failure.code(), u"42501"_s);
}

TEST_F(Connections, StopAStatementThatTakesTooLong) {
    const auto own = connect(1);
    EXPECT_EQ(failureOf([&] {
                  open(u"select count(*) from generate_series(1, 1000000000)"_s, own);
              }).code(),
              u"57014"_s);
    EXPECT_EQ(open(u"select 1 as um"_s, own)->value(0), QVariant(1));
}

// A lock goes with its connection. What was worked out from the row is written only when the row is
// still what it was.
TEST_F(Connections, ThatAreMadeAnewTakeTheirLocksAgain) {
    book.exec(u"INSERT INTO tbConta VALUES(1); INSERT INTO tbHosp(code) VALUES('a')"_s);
    const auto own = connect(1);
    const auto rows = open(u"select * from tbConta"_s, own);
    const auto counter = [&] { return book.text(u"SELECT proximo FROM tbConta"_s); };
    rows->setCollect(u"proximo"_s, 2);
    cut();
    rows->Update();
    rows->setCollect(u"proximo"_s, 3);
    cut();
    book.exec(u"SELECT pg_advisory_lock(hashtextextended('tbconta:1', 0))"_s);
    // Somebody else has the row; all others are free.
    EXPECT_EQ(open(u"select * from tbHosp"_s, own)->Collect(u"code"_s), u"a"_s);
    EXPECT_EQ(failureOf([&] { rows->Update(); }).number(), core::RowInUse);
    EXPECT_EQ(counter(), u"2"_s);
    book.exec(u"SELECT pg_advisory_unlock_all()"_s);
    rows->Update();
    EXPECT_EQ(counter(), u"3"_s);

    rows->setCollect(u"proximo"_s, 4);
    for (const bool logsIn : {false, true}) {
        cut();
        if (logsIn) {
            own->Close();
            own->Open();
        }
        book.exec(u"UPDATE tbConta SET proximo = proximo + 5"_s);
        const core::Failure failure = failureOf([&] { rows->Update(); });
        EXPECT_EQ(failure.number(), core::RowInUse);
        EXPECT_TRUE(failure.text().contains(u"entretanto alterada"_s)) << failure.what();
        EXPECT_EQ(failureOf([&] { rows->Delete(); }).number(), core::RowInUse);
    }
    EXPECT_EQ(counter(), u"13"_s);
    rows->CancelUpdate();
    EXPECT_EQ(rows->Collect(u"proximo"_s), QVariant(13));
    cut();
    book.exec(u"UPDATE tbConta SET proximo = 20"_s);
    EXPECT_EQ(failureOf([&] { rows->setCollect(u"proximo"_s, 14); }).number(), core::RowInUse);
}

TEST_F(Connections, ThatAreCutDoNotLetTwoAddTheFirstRow) {
    const auto rows =
        open(u"select * from tbConta"_s, connection, ado::adLockPessimistic, ado::adOpenDynamic);
    rows->AddNew();
    cut();
    EXPECT_EQ(failureOf([&] { rows->Update(); }).number(), core::RowInUse);
    EXPECT_EQ(book.count(u"tbConta"_s), 0);
}

TEST_F(Connections, ThatSleptStoreNothingLate) {
    const auto rows = open(u"select * from tbMov where id = 0"_s, connect(1));
    const auto add = [&] {
        rows->AddNew();
        rows->setCollect(u"nome"_s, u"a"_s);
        rows->Update();
    };
    add();
    signalBackends(SIGSTOP);
    EXPECT_TRUE(failureOf(add).text().contains(u"não respondeu"_s));
    wake();
    const QString late = u"pid IN (%1) AND query LIKE 'INSERT%'"_s.arg(stopped.join(u','));
    while (book.count(u"pg_stat_activity"_s, late) > 0) {
    }
    rows->Update();
    EXPECT_EQ(book.count(u"tbMov"_s), 2);
}

TEST_F(Connections, SayWhatTheCommitCameTo) {
    book.exec(
        u"CREATE FUNCTION fim() RETURNS trigger LANGUAGE plpgsql SECURITY DEFINER AS $$ BEGIN"
        "  IF NEW.nome = 'cai' THEN PERFORM pg_terminate_backend(pg_backend_pid()), pg_sleep(1); "
        "END IF;"
        "  IF NEW.nome = 'recusa' THEN RAISE 'recusado'; END IF; RETURN NULL; END $$;"
        "CREATE CONSTRAINT TRIGGER fim AFTER INSERT ON tbMov DEFERRABLE INITIALLY DEFERRED"
        "  FOR EACH ROW EXECUTE FUNCTION fim()"_s);
    const auto rows = open(u"select * from tbMov where id = 0"_s, connection);
    rows->AddNew();
    const auto textOfAdding = [&](const QString& name) {
        rows->setCollect(u"nome"_s, name);
        return failureOf([&] { rows->Update(); }).text();
    };
    const QString cut = textOfAdding(u"cai"_s);
    EXPECT_TRUE(cut.contains(u"procure-a antes de repetir"_s)) << qPrintable(cut);
    EXPECT_EQ(textOfAdding(u"recusa"_s), u"recusado"_s);
    EXPECT_EQ(textOfAdding(u"passa"_s), QString());
    EXPECT_EQ(book.count(u"tbMov"_s), 1);
}
