// SPDX-License-Identifier: MIT
// A book that is removed, replaced or restored beside, or under, a running program.
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <csignal>

#include "database/Book.h"
#include "platform/ado/Connection.h"
#include "platform/ado/Recordset.h"
#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;
using support::failureOf;

namespace {

ado::ConnectionPtr connect(const QString& folder) {
    auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString = u"Initial Catalog=livro;Data Source=sqlite:"_s + folder;
    connection->Open();
    return connection;
}

ado::RecordsetPtr hospitals(const ado::ConnectionPtr& connection) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(u"select * from tbHospitais"_s, connection, ado::adOpenStatic,
               ado::adLockPessimistic, ado::adCmdUnknown);
    return rows;
}

void post(const ado::RecordsetPtr& rows, const QString& name) {
    rows->AddNew();
    rows->setCollect(u"nome"_s, name);
    rows->Update();
}

void moveOver(const QString& from, const QString& to) {
    ASSERT_EQ(std::rename(QFile::encodeName(from).constData(), QFile::encodeName(to).constData()),
              0);
}

/// A book "livro" with the hospital "antes", and a copy of it.
class ReplacedBook : public testing::Test {
protected:
    void SetUp() override {
        database::createBook(folder(), u"livro"_s);
        post(hospitals(connect(folder())), u"antes"_s);
        ASSERT_TRUE(QFile::copy(file(), copy()));
    }

    QString folder() const { return root_.filePath(u"aberto"_s); }
    QString file() const { return folder() + u"/livro.db"_s; }
    QString copy() const { return root_.filePath(u"copia.db"_s); }

    static QStringList names(const QString& folder) {
        QStringList names;
        const ado::RecordsetPtr rows = hospitals(connect(folder));
        for (; !rows->atEnd(); rows->MoveNext()) names << rows->Collect(u"nome"_s).toString();
        return names;
    }
    QString failureOfOpening() const {
        return failureOf([&] { connect(folder()); }).text();
    }
    /// A program posts "depois" and is killed; the posting stands in the journal alone.
    void postAndCrash() const {
        const pid_t child = ::fork();
        if (child == 0) {
            const ado::RecordsetPtr rows = hospitals(connect(folder()));
            post(rows, u"depois"_s);
            ::kill(::getpid(), SIGKILL);
        }
        int status = 0;
        ::waitpid(child, &status, 0);
        ASSERT_TRUE(WIFSIGNALED(status));
        ASSERT_GT(QFileInfo(file() + u"-wal"_s).size(), 0);
    }
    void dropJournal() const {
        for (const QString& suffix : {u"-wal"_s, u"-shm"_s}) QFile::remove(file() + suffix);
    }

    QTemporaryDir root_;
};

TEST_F(ReplacedBook, UnderAnOpenProgramRefusesEveryReadAndWrite) {
    const struct {
        const char* told;
        std::function<void()> change;
    } cases[] = {
        {"foi apagado", [&] { QFile::remove(file()); }},
        {"foi substituído", [&] { moveOver(copy(), file()); }},
        {"sem o seu diário", [&] { QFile::remove(file() + u"-wal"_s); }},
        {"foi apagado", [&] { moveOver(folder(), root_.filePath(u"outra"_s)); }},
    };
    for (const auto& each : cases) {
        QDir(folder()).removeRecursively();
        QFile::remove(copy());
        SetUp();
        const ado::ConnectionPtr connection = connect(folder());
        const ado::RecordsetPtr rows = hospitals(connection);
        post(rows, u"depois"_s);
        rows->AddNew();
        rows->setCollect(u"nome"_s, u"perdido"_s);
        each.change();
        const QString told = QString::fromUtf8(each.told);
        for (const QString& text : {failureOf([&] { rows->Update(); }).text(),
                                    failureOf([&] { hospitals(connection); }).text()})
            EXPECT_TRUE(text.contains(told) && text.contains(file())) << qPrintable(text);
        EXPECT_TRUE(rows->isNewRow());  // still there to be kept elsewhere
    }
}

TEST_F(ReplacedBook, KeepsWhatOnlyTheJournalOfACrashHolds) {
    const QStringList both{u"antes"_s, u"depois"_s};
    postAndCrash();
    // Moved or copied with its journal it is the same book.
    const QString moved = root_.filePath(u"mudado"_s);
    const QString copied = root_.filePath(u"copiado"_s);
    moveOver(folder(), moved);
    QDir().mkpath(copied);
    for (const QString& name : QDir(moved).entryList(QDir::Files))
        ASSERT_TRUE(QFile::copy(moved + u'/' + name, copied + u'/' + name));
    EXPECT_EQ(names(moved), both);
    EXPECT_EQ(names(copied), both);
    // Cut off while the journal was carried over, long after the last posting.
    moveOver(moved, folder());
    postAndCrash();
    QFile journal(file() + u"-wal"_s);
    ASSERT_TRUE(journal.open(QFile::ReadWrite));
    ASSERT_TRUE(journal.setFileTime(QDateTime::currentDateTime().addSecs(-3600),
                                    QFile::FileModificationTime));
    EXPECT_EQ(names(folder()), both + QStringList{u"depois"_s});
}

TEST_F(ReplacedBook, RefusesTheJournalOfTheBookThatWasThereBefore) {
    postAndCrash();
    const QString another = copy() + u".outra"_s;
    ASSERT_TRUE(QFile::copy(copy(), another));
    moveOver(copy(), file());
    const QString text = failureOfOpening();
    EXPECT_TRUE(text.contains(u"não pertence ao livro"_s)) << qPrintable(text);
    EXPECT_TRUE(text.contains(file() + u"-wal"_s)) << qPrintable(text);
    EXPECT_EQ(failureOfOpening(), text) << "the refusal changed something";
    dropJournal();
    EXPECT_EQ(names(folder()), QStringList{u"antes"_s});
    // A program that is still open keeps the journal of the book that was replaced.
    const ado::ConnectionPtr open = connect(folder());
    post(hospitals(open), u"depois"_s);
    moveOver(another, file());
    EXPECT_TRUE(failureOfOpening().contains(u"não pertence ao livro"_s));
}

TEST_F(ReplacedBook, FollowsNoLinkToItsLocks) {
    const QString locks = file() + u"-locks"_s;
    const QString bystander = root_.filePath(u"alheio"_s);
    ASSERT_TRUE(QFile(bystander).open(QFile::WriteOnly));
    const std::function<void()> obstacles[] = {
        [&] { QFile::link(bystander, locks); },
        [&] { ::mkfifo(QFile::encodeName(locks).constData(), 0600); },
        [&] { QDir().mkdir(locks); },
    };
    for (const auto& obstacle : obstacles) {
        QFile::remove(locks);
        obstacle();
        const ado::RecordsetPtr rows = hospitals(connect(folder()));
        const QString text = failureOf([&] { rows->setCollect(u"nome"_s, u"x"_s); }).text();
        EXPECT_TRUE(text.contains(u"não é um ficheiro normal"_s)) << qPrintable(text);
    }
    EXPECT_EQ(QFileInfo(bystander).size(), 0);
}

}  // namespace
