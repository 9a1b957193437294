// SPDX-License-Identifier: MIT
// Rows of pessimistic sets are held against every other workstation, and nothing else is.
#include <sys/wait.h>
#include <unistd.h>

#include <QElapsedTimer>
#include <csignal>

#include "ServerBook.h"

using namespace Qt::StringLiterals;

namespace {

const QString Counter = u"select * from tbConta"_s;

int lookedAt(const ado::RecordsetPtr& rows) {
    return failureOf([&] { rows->value(0); }).number();
}

class Locks : public ServerBook {
protected:
    Locks() { exec(u"INSERT INTO tbConta VALUES(1)"_s); }

    /// Another process that holds the counter's row until it is killed.
    pid_t holder() {
        int ready[2] = {};
        EXPECT_EQ(pipe(ready), 0);
        const pid_t process = fork();
        if (process == 0) {
            const auto rows = open(Counter, connect());
            rows->value(0);
            [[maybe_unused]] const ssize_t written = write(ready[1], "x", 1);
            for (;;) pause();
        }
        char byte = 0;
        EXPECT_EQ(read(ready[0], &byte, 1), 1);
        close(ready[0]);
        close(ready[1]);
        return process;
    }

    static void end(pid_t process) {
        kill(process, SIGKILL);
        waitpid(process, nullptr, 0);
    }
};

}  // namespace

TEST_F(Locks, HoldTheCurrentRowUntilItIsStoredOrLeft) {
    fill(2);
    const QString movements = u"select * from tbMov"_s;
    const auto first = open(movements, connection);
    const auto second = open(movements, connect(1));
    EXPECT_EQ(lookedAt(first), 0);
    EXPECT_EQ(lookedAt(second), core::RowInUse);
    second->MoveNext();
    EXPECT_EQ(lookedAt(second), 0);
    first->setCollect(u"nome"_s, u"novo"_s);
    first->Update();
    second->MoveFirst();
    EXPECT_EQ(second->Collect(u"nome"_s), u"novo"_s);
    second->Close();
    EXPECT_EQ(lookedAt(open(movements, connection)), 0);
    EXPECT_EQ(lookedAt(open(movements, connection, ado::adLockOptimistic)), 0);
}

TEST_F(Locks, OfThisThreadAreRefusedAtOnce) {
    const auto first = open(Counter, connection);
    EXPECT_EQ(lookedAt(first), 0);
    QElapsedTimer waited;
    waited.start();
    for (const auto& workstation : {connection, connect(30)}) {
        const QString text = failureOf([&] { open(Counter, workstation)->value(0); }).text();
        EXPECT_TRUE(text.contains(u"outra janela deste programa"_s)) << text.toStdString();
    }
    EXPECT_LT(waited.elapsed(), 5000);
}

TEST_F(Locks, NameTheHolderAndAreFreeOnceHeIsKilled) {
    const pid_t process = holder();
    const auto rows = open(Counter, connect(1));
    QElapsedTimer waited;
    waited.start();
    const core::Failure failure = failureOf([&] { rows->value(0); });
    EXPECT_GE(waited.elapsed(), 900);
    EXPECT_LT(waited.elapsed(), 4000);
    EXPECT_EQ(failure.number(), core::RowInUse);
    EXPECT_TRUE(failure.text().contains(u'@') && failure.text().contains(u"tbConta"_s))
        << failure.what();
    EXPECT_EQ(open(Counter, connection, ado::adLockReadOnly)->value(0), QVariant(1));
    end(process);
    EXPECT_EQ(lookedAt(rows), 0);
}

TEST_F(Locks, GiveNoNumberTwice) {
    constexpr int Workstations = 4;
    constexpr int Draws = 50;
    std::vector<pid_t> processes;
    for (int i = 0; i < Workstations; ++i) {
        const pid_t process = fork();
        if (process == 0) {
            const auto own = connect(30);
            for (int k = 0; k < Draws; ++k) {
                const auto counter = open(Counter, own, ado::adLockPessimistic, ado::adOpenDynamic);
                const int number = counter->Collect(u"proximo"_s).toInt();
                counter->setCollect(u"proximo"_s, number + 1);
                counter->Update();
                const auto rows = open(u"select * from tbMov where id=0"_s, own);
                rows->AddNew();
                rows->setCollect(u"socio"_s, number);
                rows->Update();
            }
            _exit(0);
        }
        processes.push_back(process);
    }
    for (const pid_t process : processes) {
        int status = -1;
        waitpid(process, &status, 0);
        EXPECT_EQ(status, 0);
    }
    EXPECT_EQ(exec(u"SELECT count(DISTINCT socio) || '/' || min(socio) || '/' || max(socio) FROM "
                   u"tbMov"_s),
              u"200/1/200"_s);
}

// A lock goes with its connection. The next operation takes it again or writes nothing.
TEST_F(Locks, AreTakenAgainWithANewConnection) {
    const QString cut =
        u"SELECT count(pg_terminate_backend(pid, 5000)) FROM pg_stat_activity WHERE datname = "
        u"current_database() AND pid <> pg_backend_pid()"_s;
    const auto rows = open(Counter, connect(1));
    rows->setCollect(u"proximo"_s, 2);
    exec(cut);
    rows->Update();
    rows->setCollect(u"proximo"_s, 3);
    exec(cut);
    exec(u"SELECT pg_advisory_lock(hashtextextended('tbconta:1', 0))"_s);
    EXPECT_EQ(failureOf([&] { rows->Update(); }).number(), core::RowInUse);
    EXPECT_EQ(exec(u"SELECT proximo FROM tbConta"_s), u"2"_s);
    exec(u"SELECT pg_advisory_unlock_all()"_s);
    rows->Update();
    EXPECT_EQ(exec(u"SELECT proximo FROM tbConta"_s), u"3"_s);
}
