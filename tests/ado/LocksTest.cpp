// SPDX-License-Identifier: MIT
// Rows of pessimistic sets are held against everybody else, and nothing else is.
#include <sys/wait.h>
#include <unistd.h>

#include <QElapsedTimer>
#include <QTest>

#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

const QString Counter = u"select * from tbConta"_s;
const QString Hospitals = u"select * from tbHosp"_s;

/// The number with which looking at the current row fails.
int lookedAt(const ado::RecordsetPtr& rows) {
    return failureOf([&] { rows->value(0); }).number();
}

class Locks : public SmallBook {
protected:
    Locks() {
        book.exec(u"INSERT INTO tbConta VALUES(1); INSERT INTO tbHosp(code) VALUES('a'), ('b')"_s);
    }
    /// Another process, which holds the counter's row until it is killed.
    pid_t startHolder() const {
        int ready[2] = {};
        EXPECT_EQ(pipe(ready), 0);
        const pid_t process = fork();
        if (process == 0) {
            const auto rows = open(Counter, connect());
            rows->value(0);
            if (write(ready[1], "x", 1) == 1) pause();
        }
        char sign = 0;
        EXPECT_EQ(read(ready[0], &sign, 1), 1);
        return process;
    }
};

TEST_F(Locks, HoldTheCurrentRowOnly) {
    const auto first = open(Hospitals, connect());
    const auto second = open(Hospitals, connect(1));
    EXPECT_EQ(lookedAt(first), 0);
    EXPECT_EQ(lookedAt(second), core::RowInUse);
    second->MoveNext();
    EXPECT_EQ(lookedAt(second), 0);
    first->MoveNext();
    EXPECT_EQ(lookedAt(first), core::RowInUse);
    second->MoveFirst();
    EXPECT_EQ(lookedAt(second), 0);
    book.exec(u"UPDATE tbHosp SET nome='Luz'"_s);
    second->Close();
    first->MoveFirst();
    EXPECT_EQ(first->Collect(u"nome"_s), u"Luz"_s);  // read afresh before it is given
}

TEST_F(Locks, AreLetGoByUpdateAndTakenAgainByTheNextChange) {
    const auto rows = open(Hospitals, connect(1));
    rows->setCollect(u"nome"_s, u"Luz"_s);
    rows->Update();
    const auto other = open(Hospitals, connect(1));
    EXPECT_EQ(lookedAt(other), 0);
    EXPECT_EQ(lookedAt(rows), 0);  // looking at what was stored holds nothing
    EXPECT_EQ(failureOf([&] { rows->setCollect(u"nome"_s, u"Sol"_s); }).number(), core::RowInUse);
    other->Close();
    rows->setCollect(u"nome"_s, u"Sol"_s);
    EXPECT_EQ(lookedAt(open(Hospitals, connect(1))), core::RowInUse);
}

TEST_F(Locks, AreNotTakenByOtherSetsAndNewRows) {
    const auto held = open(Counter, connection);
    EXPECT_EQ(lookedAt(held), 0);
    EXPECT_EQ(lookedAt(open(Counter, connection, ado::adLockOptimistic)), 0);
    EXPECT_EQ(lookedAt(open(Counter, connection, ado::adLockUnspecified)), 0);
    EXPECT_EQ(lookedAt(open(u"select sum(proximo) from tbConta"_s, connection)), 0);
    const auto adding = open(Counter, connection);
    adding->AddNew();
    adding->setCollect(u"proximo"_s, 5);
    adding->Update();
    EXPECT_EQ(adding->Collect(u"proximo"_s), QVariant(5));
}

TEST_F(Locks, OfThisProgramAreRefusedAtOnce) {
    const auto first = open(Counter, connection);
    EXPECT_EQ(lookedAt(first), 0);
    QElapsedTimer waited;
    waited.start();
    for (const auto& workstation : {connection, connect(30)}) {
        const QString text = failureOf([&] { open(Counter, workstation)->value(0); }).text();
        EXPECT_TRUE(text.contains(u"outra janela deste programa"_s)) << qPrintable(text);
    }
    EXPECT_LT(waited.elapsed(), 5000);
}

TEST_F(Locks, NameTheHolderAfterTheTimeoutAndAreFreeOnceItIsKilled) {
    const pid_t holder = startHolder();
    const auto rows = open(Counter, connect(1));
    QElapsedTimer waited;
    waited.start();
    const QString text = failureOf([&] { rows->value(0); }).text();
    EXPECT_GE(waited.elapsed(), 900);
    EXPECT_LT(waited.elapsed(), 4000);
    EXPECT_TRUE(text.contains(u"tbConta"_s) && text.contains(u'@')) << qPrintable(text);
    EXPECT_EQ(open(Counter, connection, ado::adLockReadOnly)->value(0), QVariant(1));
    EXPECT_EQ(rows->readValue(u"proximo"_s), QVariant(1));  // a mere lookup
    const auto impatient = open(Counter, connect(0));
    EXPECT_EQ(lookedAt(impatient), core::RowInUse);
    kill(holder, SIGKILL);
    waitpid(holder, nullptr, 0);
    // A server sees the cut connection a moment later.
    EXPECT_TRUE(QTest::qWaitFor([&] { return lookedAt(impatient) == 0; }, 2000));
}

}  // namespace
