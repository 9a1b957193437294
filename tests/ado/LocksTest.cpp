// SPDX-License-Identifier: MIT
// Rows of pessimistic sets are held against everybody else, and nothing else is.
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QElapsedTimer>
#include <thread>

#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

const QString Counter = u"select * from tbConta"_s;

/// As every posting does it.
int draw(const ado::ConnectionPtr& connection) {
    const auto rows = openRows(Counter, connection, ado::adOpenDynamic, ado::adLockPessimistic);
    const int number = rows->Collect(u"proximo"_s).toInt();
    rows->setCollect(u"proximo"_s, number + 1);
    rows->Update();
    rows->Close();
    return number;
}

int lookedAt(const ado::RecordsetPtr& rows) {
    return failureNumberOf([&] { rows->value(0); });
}

/// Another process that holds the counter's row until it is killed.
class Holder {
public:
    explicit Holder(const SmallBook& book) {
        EXPECT_EQ(pipe(pipe_), 0);
        process_ = fork();
        if (process_ == 0) {
            const auto rows = openRows(Counter, book.connect());
            rows->value(0);
            [[maybe_unused]] const ssize_t written = write(pipe_[1], "x", 1);
            for (;;) pause();
        }
        char ready = 0;
        EXPECT_EQ(read(pipe_[0], &ready, 1), 1);
    }
    ~Holder() {
        kill();
        close(pipe_[0]);
        close(pipe_[1]);
    }
    void kill() {
        if (process_ > 0) {
            ::kill(process_, SIGKILL);
            waitpid(process_, nullptr, 0);
        }
        process_ = 0;
    }

private:
    int pipe_[2] = {};
    pid_t process_ = 0;
};

class Locks : public testing::Test {
protected:
    Locks() {
        book.exec(u"INSERT INTO tbConta VALUES(1); INSERT INTO tbHosp(code) VALUES('a'), ('b')"_s);
    }
    SmallBook book;
};

}  // namespace

TEST_F(Locks, HoldTheCurrentRowOnly) {
    const auto first = openRows(u"select * from tbHosp"_s, book.connect());
    const auto second = openRows(u"select * from tbHosp"_s, book.connect());
    EXPECT_EQ(lookedAt(first), 0);
    EXPECT_EQ(lookedAt(second), core::RowInUse);
    second->MoveNext();
    EXPECT_EQ(lookedAt(second), 0);
    first->MoveNext();
    EXPECT_EQ(lookedAt(first), core::RowInUse);
    second->MoveFirst();
    EXPECT_EQ(lookedAt(second), 0);
    second->Close();
    first->MoveFirst();
    EXPECT_EQ(lookedAt(first), 0);
}

TEST_F(Locks, AreLetGoByUpdateAndTakenAgainByTheNextChange) {
    const auto rows = openRows(u"select * from tbHosp"_s, book.connect());
    rows->setCollect(u"nome"_s, u"Luz"_s);
    rows->Update();
    const auto other = openRows(u"select * from tbHosp"_s, book.connect());
    EXPECT_EQ(lookedAt(other), 0);
    EXPECT_EQ(lookedAt(rows), 0);  // looking at what was stored holds nothing
    EXPECT_EQ(failureNumberOf([&] { rows->setCollect(u"nome"_s, u"Sol"_s); }), core::RowInUse);
    other->Close();
    rows->setCollect(u"nome"_s, u"Sol"_s);
    EXPECT_EQ(lookedAt(openRows(u"select * from tbHosp"_s, book.connect())), core::RowInUse);
}

TEST_F(Locks, AreNotTakenByOtherSetsAndNewRows) {
    const auto connection = book.connect();
    const auto held = openRows(Counter, connection);
    EXPECT_EQ(lookedAt(held), 0);
    EXPECT_EQ(lookedAt(openRows(Counter, connection, ado::adOpenStatic, ado::adLockOptimistic)), 0);
    EXPECT_EQ(
        lookedAt(openRows(Counter, connection, ado::adOpenUnspecified, ado::adLockUnspecified)), 0);
    EXPECT_EQ(lookedAt(openRows(u"select sum(proximo) from tbConta"_s, connection)), 0);
    const auto adding = openRows(Counter, connection);
    adding->AddNew();
    adding->setCollect(u"proximo"_s, 5);
    adding->Update();
    EXPECT_EQ(adding->Collect(u"proximo"_s), QVariant(5));
}

TEST_F(Locks, ReadTheRowAfreshBeforeItIsGiven) {
    const auto connection = book.connect();
    const auto rows = openRows(Counter, connection);
    book.exec(u"UPDATE tbConta SET proximo=8"_s);
    EXPECT_EQ(rows->Collect(u"proximo"_s), QVariant(8));
}

TEST_F(Locks, NameTheHolderAndGiveUpAfterTheTimeout) {
    const Holder holder(book);
    const auto rows = openRows(Counter, book.connect(u"SQLOLEDB.1"_s, 1));
    QElapsedTimer waited;
    waited.start();
    const QString text = failureOf([&] { rows->value(0); });
    EXPECT_GE(waited.elapsed(), 900);
    EXPECT_TRUE(text.contains(u"tbConta"_s) && text.contains(u'@')) << text.toStdString();
}

TEST_F(Locks, OfAProcessThatIsKilledAreFreeAtOnce) {
    Holder holder(book);
    const auto rows = openRows(Counter, book.connect(u"SQLOLEDB.1"_s, 0));
    EXPECT_EQ(lookedAt(rows), core::RowInUse);
    holder.kill();
    EXPECT_EQ(lookedAt(rows), 0);
}

TEST_F(Locks, GiveNoNumberTwice) {
    constexpr int Workstations = 4;
    constexpr int Draws = 50;
    std::vector<pid_t> processes;
    for (int i = 0; i < Workstations; ++i) {
        const pid_t process = fork();
        if (process == 0) {
            const auto connection = book.connect(u"SQLOLEDB.1"_s, 30);
            for (int k = 0; k < Draws; ++k) {
                const auto rows = openRows(u"select * from tbMov where id=0"_s, connection);
                const int number = draw(connection);
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
    EXPECT_EQ(book.value(u"SELECT count(DISTINCT socio) || '/' || min(socio) || '/' || max(socio) "
                         u"FROM tbMov"_s),
              u"200/1/200"_s);
    EXPECT_EQ(book.value(u"SELECT proximo FROM tbConta"_s), u"201"_s);
}
