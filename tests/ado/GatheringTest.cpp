// SPDX-License-Identifier: MIT
#include "SmallBook.h"
#include "platform/ado/GatheredWrites.h"

using namespace Qt::StringLiterals;

namespace {

const QString Movements = u"select * from tbMov"_s;
constexpr int Many = 700;  // more than go to a server at once

class Gathering : public SmallBook {
protected:
    void add(const ado::RecordsetPtr& rows, int from, int to) {
        for (int number = from; number <= to; ++number) {
            rows->AddNew();
            rows->setCollect(u"nome"_s, u"n%1"_s.arg(number));
            rows->Update();
        }
    }
    QString state() {
        return book.text(u"select count(*), min(nome), max(nome), min(id), max(id) from tbMov"_s);
    }
};

TEST_F(Gathering, AllWritesAreInTheBookAtTheEndAndSeenByWhoeverReadsMeanwhile) {
    const auto rows = open(Movements, connection, ado::adLockOptimistic);
    ado::GatheredWrites writes(connection);
    add(rows, 1, Many);
    const auto read = open(Movements, connection, ado::adLockOptimistic, ado::adOpenDynamic);
    for (; !read->atEnd(); read->MoveNext()) {
        const int id = read->Collect(u"id"_s).toInt();
        if (id % 3 == 0) {
            read->Delete();
        } else if (id % 3 == 1) {
            read->setCollect(u"nome"_s, u"x"_s);
            read->Update();
            EXPECT_EQ(read->Collect(u"nome"_s), u"x"_s);
        }
    }
    const auto again = open(u"select * from tbMov where nome = 'x'"_s, connection);
    EXPECT_EQ(again->RecordCount(), (Many + 2) / 3);
    writes.store();
    EXPECT_EQ(state(), u"%1|n101|x|1|%2"_s.arg(Many - Many / 3).arg(Many));
    // What comes later is a commit of its own again.
    add(rows, 1001, 1001);
    EXPECT_EQ(rows->Collect(u"id"_s), QVariant(Many + 1));
    EXPECT_EQ(book.count(u"tbMov"_s), Many - Many / 3 + 1);
}

TEST_F(Gathering, ARowThatFailsLeavesThoseBeforeItStanding) {
    book.exec(u"create unique index once on tbMov (nome)"_s);
    fill(1);
    book.exec(u"update tbMov set nome = 'n600'"_s);
    const auto rows = open(Movements, connection, ado::adLockOptimistic);
    const core::Failure failure = failureOf([&] {
        ado::GatheredWrites writes(connection);
        add(rows, 1, Many);
        writes.store();
    });
    EXPECT_EQ(failure.number(), core::DatabaseFailure);
    EXPECT_TRUE(failure.text().contains(u"nome"_s)) << failure.what();
    EXPECT_EQ(book.count(u"tbMov"_s), 600);
    EXPECT_EQ(book.count(u"tbMov"_s, u"nome in ('n1', 'n599', 'n601')"_s), 2);
}

TEST_F(Gathering, WorkThatFailsByItselfKeepsWhatItWrote) {
    const auto rows = open(Movements, connection, ado::adLockOptimistic);
    EXPECT_THROW(
        {
            const ado::GatheredWrites writes(connection);
            add(rows, 1, 10);
            throw core::Failure(core::InvalidCall, u"fim"_s);
        },
        core::Failure);
    EXPECT_EQ(book.count(u"tbMov"_s), 10);
}

TEST_F(Gathering, ACounterIsHeldUntilItsSetIsClosed) {
    fill(1);
    const auto counter = open(Movements, connection, ado::adLockPessimistic, ado::adOpenDynamic);
    const auto rows = open(u"select * from tbHosp"_s, connection, ado::adLockOptimistic);
    ado::GatheredWrites writes(connection);
    for (int number = 1; number <= Many; ++number) {
        counter->setCollect(u"socio"_s, number);
        counter->Update();
        rows->AddNew();
        rows->setCollect(u"code"_s, counter->Collect(u"socio"_s));
        rows->Update();
    }
    const auto other = connect(1);
    const auto held = open(Movements, other, ado::adLockPessimistic, ado::adOpenDynamic);
    EXPECT_EQ(failureOf([&] { held->Collect(u"socio"_s); }).number(), core::RowInUse);
    counter->Close();
    writes.store();
    EXPECT_EQ(book.text(u"select socio, (select count(*) from tbHosp), (select max(code) from "
                        "tbHosp) from tbMov"_s),
              u"700|700|99"_s);
}

}  // namespace
