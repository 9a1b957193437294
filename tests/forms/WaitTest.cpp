// SPDX-License-Identifier: MIT
// What the operator sees while the book is busy.
#include <gtest/gtest.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <QElapsedTimer>
#include <QLabel>
#include <atomic>
#include <csignal>
#include <thread>

#include "platform/ado/Recordset.h"
#include "platform/core/Wait.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"
#include "tests/support/Book.h"
#include "tests/support/Failure.h"
#include "tests/support/Operator.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;

namespace {

/// A screen with one button.
class Desk : public forms::Form {
public:
    explicit Desk(const QString& name)
        : Form(name, name), Command3(u"Command3"_s, u"&Gravar"_s, this) {}
    forms::Button Command3;
    int painted = 0;

protected:
    void paintEvent(QPaintEvent*) override { ++painted; }
};

class Waits : public testing::Test {
protected:
    Waits() {
        desk.Show();
        other.Show();
        person.screen(u"frmMesa"_s);
    }
    ~Waits() override { wake(); }

    ado::ConnectionPtr connect(const QString& text = {}) const {
        auto made = std::make_shared<ado::Connection>();
        made->ConnectionString = text.isEmpty() ? book.connectionString() : text;
        made->CommandTimeout = 60;
        made->Open();
        return made;
    }
    static ado::RecordsetPtr open(const QString& statement, const ado::ConnectionPtr& connection,
                                  ado::LockType lock = ado::adLockOptimistic) {
        auto rows = ado::Recordset::create();
        rows->Open(statement, connection, ado::adOpenStatic, lock);
        return rows;
    }

    /// Presses the button, whose work has to wait, looks around, and gives up.
    void giveUp(const std::function<void()>& work, const QString& waitsFor, const QString& told) {
        desk.Command3.onClick = work;
        QElapsedTimer sinceGivenUp;
        int ticks = 0;
        forms::Timer timer(u"Timer1"_s, 1, &other);
        timer.onTimer = [&] {
            EXPECT_FALSE(core::isWaiting());
            ++ticks;
        };
        int clicks = 0;
        other.Command3.onClick = [&] { ++clicks; };
        person.onScreen(u"frmEspera"_s, [&] {
            EXPECT_TRUE(core::isWaiting());
            const QString text = person.find<QLabel>(u"Label1"_s)->text();
            EXPECT_TRUE(text.startsWith(waitsFor)) << qPrintable(text);
            person.type(u" \r"_s);  // typed ahead
            EXPECT_TRUE(person.isShown(u"frmEspera"_s));
            timer.setEnabled(true);
            const int before = other.painted;
            other.update();
            person.waitUntil([&] { return other.painted > before; }, u"the other screen"_s);
            other.Command3.click();  // as a program does
            sinceGivenUp.start();
            person.accelerator(u'D');
        });
        person.expectBox({.text = told, .icon = core::Icon::Critical, .partly = true});
        person.click(u"Command3"_s);
        EXPECT_LT(sinceGivenUp.elapsed(), 1000);
        EXPECT_FALSE(core::isWaiting());
        EXPECT_FALSE(person.isShown(u"frmEspera"_s));
        EXPECT_EQ(clicks, 0);
        person.expectNoBoxesLeft();
        person.screen(u"frmMesa"_s);
        person.waitUntil([&] { return ticks > 0; }, u"the timer after the wait"_s);
    }
    /// The same button, once nothing is in the way.
    void tryAgain() {
        person.click(u"Command3"_s);
        EXPECT_FALSE(person.isShown(u"frmEspera"_s));
    }

    /// Everything on the server that works for this book answers no more.
    void stall() {
        const QString text = book.text(
            u"SELECT pid FROM pg_stat_activity WHERE datname = current_database() "
            "AND pid <> pg_backend_pid()"_s);
        stalled = text.split(u'\n', Qt::SkipEmptyParts);
        for (const QString& process : stalled) kill(process.toInt(), SIGSTOP);
    }
    void wake() {
        for (const QString& process : stalled) kill(process.toInt(), SIGCONT);
        stalled.clear();
    }

    support::Book book;
    support::Operator person;
    Desk& desk = *new Desk(u"frmMesa"_s);
    Desk& other = *new Desk(u"frmOutra"_s);
    QStringList stalled;
    void TearDown() override {
        desk.Unload();
        other.Unload();
    }
};

TEST_F(Waits, ForABookThatAnotherProgramHoldsCanBeGivenUp) {
    book.member({});
    const auto rows = open(u"select * from tbSocios"_s, connect());
    book.hold(u"tbSocios"_s);
    rows->setCollect(u"nome"_s, u"Novo"_s);
    if (support::onServer())
        giveUp([&] { rows->Update(); }, u"À espera da resposta do servidor"_s,
               u"Desistiu de esperar pela resposta. A linha pode ter ficado gravada"_s);
    else
        giveUp([&] { rows->Update(); }, u"À espera de que outro programa largue o livro."_s,
               u"Desistiu de esperar; nada foi gravado."_s);
    book.letGo();
    tryAgain();
    EXPECT_EQ(book.text(u"select nome from tbSocios"_s), u"Novo"_s);
}

TEST_F(Waits, ForARowThatAnotherWorkstationHoldsCanBeGivenUp) {
    book.hospital();
    std::atomic<bool> isHeld = false;
    std::atomic<bool> isOver = false;
    std::thread holder([&] {
        const auto rows = open(u"select * from tbHospitais"_s, connect(), ado::adLockPessimistic);
        rows->value(0);
        isHeld = true;
        while (!isOver) std::this_thread::yield();
    });
    person.waitUntil([&] { return bool(isHeld); }, u"the holder"_s);
    const auto own = connect();
    QVariant name;
    giveUp(
        [&] {
            const auto rows = open(u"select * from tbHospitais"_s, own, ado::adLockPessimistic);
            name = rows->Collect(u"nome"_s);
        },
        support::onServer() ? u"À espera da resposta do servidor"_s
                            : u"À espera de uma linha que está a ser usada por "_s,
        u"Desistiu de esperar; nada foi gravado."_s);
    EXPECT_TRUE(name.isNull());
    isOver = true;
    holder.join();
    tryAgain();
    EXPECT_EQ(name, u"Hospital da Luz Nova"_s);
}

TEST_F(Waits, ForALongStatementCanBeGivenUp) {
    const auto own = connect();
    int limit = 0;
    const auto count = [&] {
        open(
            u"select count(*) from (with recursive n(i) as (select 1 union all select i + 1 from "
            "n where i <> %1) select i from n) as x"_s.arg(limit),
            own);
    };
    giveUp(count, u"À espera d"_s, u"Desistiu de esperar; nada foi gravado."_s);
    limit = 5;
    tryAgain();
}

TEST_F(Waits, ForAServerThatStopsAnsweringCanBeGivenUp) {
    if (!support::onServer()) GTEST_SKIP() << "a file has no server";
    book.hospital();
    const auto own = connect();
    open(u"select * from tbHospitais"_s, own);
    stall();
    giveUp([&] { open(u"select * from tbHospitais"_s, own); },
           u"À espera da resposta do servidor"_s, u"Desistiu de esperar; nada foi gravado."_s);
    wake();
    tryAgain();
}

TEST_F(Waits, ForAConnectionCanBeGivenUp) {
    if (!support::onServer()) GTEST_SKIP() << "a file has no server";
    const QString host = support::Server::instance().folder();
    sockaddr_un address{AF_UNIX, {}};
    const QByteArray path = host.toUtf8() + "/.s.PGSQL.5997";
    std::copy(path.begin(), path.end(), address.sun_path);
    const int silent = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    ASSERT_EQ(bind(silent, reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
    ASSERT_EQ(listen(silent, 1), 0);
    QString text = book.connectionString().replace(host, host + u":5997"_s);
    giveUp([&] { connect(text); }, u"À espera da ligação a «postgresql:"_s,
           u"Desistiu de esperar; nada foi gravado."_s);
    close(silent);
    text = book.connectionString();
    tryAgain();
}

}  // namespace
