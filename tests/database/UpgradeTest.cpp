// SPDX-License-Identifier: MIT
// Books of the first program, brought up to date.
#include "database/Upgrade.h"

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QFile>
#include <csignal>

#include "boundary/environment/dtZelmars.h"
#include "database/Backup.h"
#include "database/Book.h"
#include "database/Schema.h"
#include "database/ServerBook.h"
#include "database/Version.h"
#include "tests/coverage/Desk.h"
#include "tests/database/FirstBook.h"
#include "tests/support/Failure.h"

using namespace Qt::StringLiterals;
using database::BookPlace;
using support::failureOf;

namespace {

void ignore(const QString&) {}

/// Runs something in a process of its own; gives its number.
pid_t beside(const std::function<void()>& work) {
    const pid_t child = ::fork();
    if (child != 0) return child;
    work();
    ::_exit(0);
}

/// Line by line, because all of it in one would not be read.
void expectSame(const QStringList& are, const QStringList& expected) {
    EXPECT_EQ(are.size(), expected.size());
    for (const QString& line : expected)
        EXPECT_TRUE(are.contains(line)) << "lacks " << line.toStdString();
    for (const QString& line : are)
        EXPECT_TRUE(expected.contains(line)) << "has " << line.toStdString();
}

/// The desk is there for its member's documents; its own book is not the one that is upgraded.
class Upgrade : public Desk, public testing::WithParamInterface<bool> {
protected:
    Upgrade() : place_(GetParam() ? FirstBook::onServer(name()) : FirstBook::inFile(folder())) {}
    ~Upgrade() override {
        // The catalogue goes with the run's server.
        auto& connection = *environment::dtZelmars::instance().MSAccess();
        if (connection.State() != ado::adStateOpen) connection.Open();
    }

    static QString name() {
        static int made = 0;
        return u"velho%1"_s.arg(++made);
    }
    QString folder() const { return root_.filePath(u"livro"_s); }
    QString backup() const { return root_.filePath(u"antes"_s); }
    BookPlace newBook() const {
        if (!GetParam()) {
            const BookPlace made{root_.filePath(u"novo"_s), {}, u"livro"_s};
            database::createBook(made.folder, made.name);
            return made;
        }
        const BookPlace made = FirstBook::placeOnServer(u"novo_"_s + name());
        database::initBook(made.server, {u"posto_"_s + made.name, u"segredo"_s}, false);
        return made;
    }
    int version() const { return database::schemaVersion(*database::opened(place_)); }
    void work() const {
        const ado::ConnectionPtr connection = environment::dtZelmars::instance().MSAccess();
        connection->Close();
        connection->ConnectionString =
            GetParam()
                ? u"User ID=posto_%1;Password=segredo;Initial Catalog=%1;Data Source=%2"_s.arg(
                      place_.name, place_.server.dataSource())
                : u"Initial Catalog=livro;Data Source=sqlite:"_s + folder();
        connection->Open();
    }

    QTemporaryDir root_;
    const BookPlace place_;
};

INSTANTIATE_TEST_SUITE_P(OnBothEngines, Upgrade, testing::Bool(),
                         [](const auto& engine) { return engine.param ? "server" : "file"; });

TEST_P(Upgrade, MakesTheFirstBookEqualToANewOneAndKeepsItsRows) {
    const QStringList rows = FirstBook::rowsOf(place_);
    ASSERT_GT(rows.size(), 30);
    const QStringList schema = FirstBook::schemaOf(place_);
    EXPECT_EQ(database::bringUpToDate(place_, backup(), ignore), 1);
    const QStringList after = FirstBook::schemaOf(place_);
    const QStringList expected = FirstBook::schemaOf(newBook());
    EXPECT_NE(schema, expected);
    expectSame(after, expected);
    expectSame(FirstBook::rowsOf(place_), rows);
    // Nothing is left to do, and no second backup is made.
    EXPECT_EQ(database::bringUpToDate(place_, root_.filePath(u"outra"_s), ignore),
              database::SchemaVersion);
    EXPECT_FALSE(QFile::exists(root_.filePath(u"outra"_s)));
}

TEST_P(Upgrade, LetsDocumentsBePostedByTheOldOperator) {
    database::bringUpToDate(place_, backup(), ignore);
    work();
    socio = 1;
    EXPECT_TRUE(post(enter({.rubrica_id = 2, .doc_valor = 10})));
    const auto opened = database::opened(place_);
    EXPECT_EQ(opened->number("SELECT movimento_no FROM tbZelmar_Movimentos WHERE movimento_id = 3"),
              4);
    EXPECT_EQ(opened->number("SELECT zelmars FROM tbContadores"), 5);
    EXPECT_EQ(opened->number("SELECT no_docs FROM tbSocios_Acumulados WHERE socio_id = 1"), 2);
}

TEST_P(Upgrade, ThatFailsLeavesTheBookAsItWas) {
    const QStringList schema = FirstBook::schemaOf(place_);
    const QStringList rows = FirstBook::rowsOf(place_);
    int told = 0;
    const core::Failure failure = failureOf([&] {
        database::bringUpToDate(place_, backup(), [&](const QString&) {
            if (++told == 2) throw core::Failure(core::InvalidCall, u"disco cheio"_s);
        });
    });
    EXPECT_TRUE(failure.text().endsWith(u"ficou como estava: disco cheio"_s));
    EXPECT_EQ(FirstBook::schemaOf(place_), schema);
    EXPECT_EQ(FirstBook::rowsOf(place_), rows);
    // The backup stands, and is not written over by the next attempt.
    EXPECT_TRUE(QFile::exists(backup()));
    EXPECT_NE(failureOf([&] { database::bringUpToDate(place_, backup(), ignore); }).number(), 0);
    EXPECT_EQ(version(), 1);
    EXPECT_EQ(database::bringUpToDate(place_, root_.filePath(u"outra"_s), ignore), 1);
}

TEST_P(Upgrade, CanBeTakenBackByItsBackupAndDoneAgain) {
    const QStringList rows = FirstBook::rowsOf(place_);
    EXPECT_EQ(database::bringUpToDate(place_, backup(), ignore), 1);
    const QStringList schema = FirstBook::schemaOf(place_);
    database::opened(place_)->execute(
        "INSERT INTO tbOperacoes (operacao_id, passo) VALUES ('x', 'ACU');"
        "UPDATE tbContadores SET zelmars = 5");
    EXPECT_EQ(database::versionInBackup(backup(), place_), 1);
    database::restoreBook(backup(), place_, true);
    EXPECT_EQ(version(), 1);
    expectSame(FirstBook::rowsOf(place_), rows);
    EXPECT_EQ(database::bringUpToDate(place_, root_.filePath(u"outra"_s), ignore), 1);
    expectSame(FirstBook::schemaOf(place_), schema);
    expectSame(FirstBook::rowsOf(place_), rows);
    EXPECT_EQ(database::opened(place_)->number("SELECT count(*) FROM tbOperacoes"), 0);
}

TEST_P(Upgrade, IsRefusedToABookNewerThanTheProgramAsEverythingElseIs) {
    database::bringUpToDate(place_, backup(), ignore);
    const QString kept = root_.filePath(u"futuro"_s);
    database::opened(place_)->execute("UPDATE tbVersao SET versao = 1000");
    const std::function<void()> attempts[] = {
        [&] { database::bringUpToDate(place_, kept, ignore); },
        [&] { database::opened(place_); },
        [&] { database::backUpBook(place_, kept); },
        [&] { database::refuseOtherVersion(place_); },
    };
    for (const auto& attempt : attempts)
        EXPECT_TRUE(failureOf(attempt).text().contains(u"Instale o programa mais recente"_s));
    EXPECT_FALSE(QFile::exists(kept));
    if (GetParam()) return;
    ASSERT_TRUE(QFile::copy(database::bookFile(place_.folder, place_.name), kept));
    EXPECT_TRUE(failureOf([&] { database::restoreBook(kept, place_, true); })
                    .text()
                    .contains(u"Instale o programa mais recente"_s));
}

TEST_P(Upgrade, WaitsUntilNobodyElseHasTheBookOpen) {
    int ready[2];
    ASSERT_EQ(::pipe(ready), 0);
    const pid_t other = beside([&] {
        const auto open = database::opened(place_);
        open->begin(ado::BulkAccess::Purpose::Reading);
        open->number("SELECT count(*) FROM tbSocios");
        if (::write(ready[1], "x", 1) == 1) ::pause();
    });
    char isOpen = 0;
    ASSERT_EQ(::read(ready[0], &isOpen, 1), 1);
    const core::Failure failure =
        failureOf([&] { database::bringUpToDate(place_, backup(), ignore); });
    EXPECT_TRUE(failure.text().contains(u"está aberto por"_s)) << failure.text().toStdString();
    EXPECT_FALSE(QFile::exists(backup()));
    ::kill(other, SIGKILL);
    ::waitpid(other, nullptr, 0);
    EXPECT_EQ(version(), 1);
}

TEST_P(Upgrade, ThatIsKilledLeavesTheBookAsItWas) {
    const QStringList schema = FirstBook::schemaOf(place_);
    const QStringList rows = FirstBook::rowsOf(place_);
    const pid_t child = beside([&] {
        database::bringUpToDate(place_, backup(), [told = 0](const QString&) mutable {
            if (++told == 2) ::kill(::getpid(), SIGKILL);
        });
    });
    int status = 0;
    ::waitpid(child, &status, 0);
    ASSERT_TRUE(WIFSIGNALED(status));
    EXPECT_EQ(FirstBook::schemaOf(place_), schema);
    EXPECT_EQ(FirstBook::rowsOf(place_), rows);
}

TEST(UpgradeOnServer, IsTheAdministratorsAndSaysSo) {
    const BookPlace place = FirstBook::onServer(u"alheio"_s);
    BookPlace asOperator = place;
    asOperator.server.user = u"posto_alheio"_s;
    asOperator.server.password = u"segredo"_s;
    QTemporaryDir root;
    const core::Failure failure =
        failureOf([&] { database::bringUpToDate(asOperator, root.filePath(u"antes"_s), ignore); });
    EXPECT_TRUE(failure.text().contains(u"não é administrador"_s)) << failure.text().toStdString();
    const QString why = failureOf([&] { database::refuseOtherVersion(asOperator); }).text();
    EXPECT_TRUE(why.contains(u"zelmars upgrade --book postgresql:"_s)) << why.toStdString();
}

}  // namespace
