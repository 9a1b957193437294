// SPDX-License-Identifier: MIT
// The program itself, started as a person starts it.
#include <gtest/gtest.h>

#include <QDir>
#include <QLockFile>
#include <QProcess>
#include <QScopeGuard>
#include <QTemporaryDir>

#include "host/MovementBook.h"
#include "platform/ado/postgres/BulkAccess.h"
#include "platform/ado/sqlite/BulkAccess.h"
#include "platform/com/Component.h"
#include "tests/support/Server.h"

using namespace Qt::StringLiterals;

namespace {

/// The program with settings of its own, in a temporary folder.
class Program : public testing::Test {
protected:
    void start(QProcess& program, const QStringList& words) const {
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert(u"ZELMARS_REGISTRY"_s, folder_.filePath(u"registry"_s));
        environment.insert(u"ZELMARS_USER_PASSWORD"_s, u"segredo"_s);
        program.setProcessEnvironment(environment);
        program.start(QCoreApplication::applicationDirPath() + u"/zelmars"_s, words);
    }
    int run(const QStringList& words) {
        QProcess program;
        start(program, words);
        EXPECT_TRUE(program.waitForFinished(60'000));
        errors_ = QString::fromUtf8(program.readAllStandardError());
        return program.exitCode();
    }
    /// Kills the program in the moment in which the condition holds.
    void killWhen(const std::function<bool()>& isTime, const QStringList& words) const {
        QProcess program;
        start(program, words);
        while (!isTime() && program.state() != QProcess::NotRunning) program.waitForFinished(0);
        program.kill();
        program.waitForFinished();
        EXPECT_EQ(program.exitStatus(), QProcess::CrashExit) << "it ended before";
    }
    /// While it is held, nothing can be written to the settings, so that the program stands before
    /// that step.
    QString settingsLock() const {
        QDir().mkpath(folder_.filePath(u"registry"_s));
        return folder_.filePath(u"registry/HKEY_LOCAL_MACHINE.ini.lock"_s);
    }
    QString book() const { return folder_.filePath(u"livro"_s); }

    QTemporaryDir folder_;
    QString errors_;
};

}  // namespace

TEST_F(Program, MakesABookOnceAndNeverOverIt) {
    EXPECT_EQ(run({u"init"_s, book()}), 0) << errors_.toStdString();
    QFile file(book() + u"/zelmars.db"_s);
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    const QByteArray made = file.readAll();
    EXPECT_EQ(run({u"init"_s, u"--sample"_s, book()}), 1);
    EXPECT_FALSE(errors_.isEmpty());
    file.seek(0);
    EXPECT_EQ(file.readAll(), made);
    // A set-up that runs again leaves the book that is in use alone.
    EXPECT_EQ(run({u"init"_s, u"--if-needed"_s, folder_.filePath(u"outro"_s)}), 0);
    EXPECT_FALSE(QFile::exists(folder_.filePath(u"outro"_s)));
}

TEST_F(Program, EndsWithTheNextCallABookThatWasCutOff) {
    const QStringList init{u"init"_s, u"--sample"_s, book()};
    const QString file = book() + u"/zelmars.db"_s;
    const auto exists = [](const QString& name) { return [=] { return QFile::exists(name); }; };
    ASSERT_EQ(run({u"register"_s}), 0);
    const std::function<bool()> moments[] = {
        exists(book()), exists(file + u".novo"_s),
        [&] { return QFileInfo(file + u".novo"_s).size() > 0; }, exists(file + u".novo-journal"_s),
        exists(file)};
    for (const auto& moment : moments) {
        QDir(book()).removeRecursively();
        QFile::remove(folder_.filePath(u"registry/HKEY_LOCAL_MACHINE.ini"_s));
        QLockFile lock(settingsLock());
        ASSERT_TRUE(lock.lock());
        killWhen(moment, init);
        EXPECT_EQ(run({u"Login"_s}), 1);
        lock.unlock();
        ASSERT_EQ(run(init), 0) << errors_.toStdString();
        EXPECT_EQ(run({u"Login"_s}), 0) << errors_.toStdString();
        EXPECT_EQ(QDir(book()).entryList({u"*.novo*"_s}, QDir::Files), QStringList());
        ado::sqlite::BulkAccess made(file);
        EXPECT_EQ(made.number("select count(*) from vwZelmars_Movimentos_Vigor"), 4000);
        EXPECT_EQ(run(init), 1);  // once only
    }
}

TEST_F(Program, EndsWithTheNextCallABookOnAServerThatWasCutOff) {
    const QString folder = support::Server::instance().folder();
    const QString admin = QString::fromLatin1(support::Server::User);
    const QStringList init{u"init"_s,      u"--server"_s, u"postgresql:"_s + folder,
                           u"--catalog"_s, u"meio"_s,     u"--admin"_s,
                           admin};
    const auto has = [&](const QString& catalogue, const QByteArray& what) {
        using ado::postgres::BulkAccess;
        return BulkAccess({folder, {}, admin, {}, catalogue})
            .number("select exists (" + what + ')');
    };
    const auto isMade = [&] {
        return has(u"postgres"_s, "select from pg_database where datname = 'meio'") != 0;
    };
    const std::function<bool()> moments[] = {
        isMade, [&] {
            return isMade() && has(u"meio"_s, "select from pg_class where relname = 'tbcheques'");
        }};
    ASSERT_EQ(run({u"register"_s}), 0);
    for (const auto& moment : moments) {
        QLockFile lock(settingsLock());
        ASSERT_TRUE(lock.lock());
        killWhen(moment, init);
        EXPECT_EQ(run({u"Login"_s}), 1);
        lock.unlock();
        // Another call than the one that was cut off does not take the book for its own.
        const bool isWhole = &moment != &moments[0];
        EXPECT_TRUE(!isWhole || run(init + QStringList{u"--sample"_s}) == 1);
        ASSERT_EQ(run(init), 0) << errors_.toStdString();
        EXPECT_EQ(run({u"Login"_s}), 0) << errors_.toStdString();
        EXPECT_EQ(run(init), 1);  // once only
        ado::postgres::BulkAccess({folder, {}, admin, {}, u"postgres"_s})
            .execute("drop database meio with (force)");
        QFile::remove(folder_.filePath(u"registry/HKEY_LOCAL_MACHINE.ini"_s));
    }
}

TEST_F(Program, LogsInThroughTheComponentWhichItRegistersByItself) {
    const auto isRegistered = [&] {
        const QByteArray own = qgetenv("ZELMARS_REGISTRY");
        qputenv("ZELMARS_REGISTRY", QFile::encodeName(folder_.filePath(u"registry"_s)));
        const auto putBack = qScopeGuard([&] { qputenv("ZELMARS_REGISTRY", own); });
        return com::isRegistered(u"Zelmars.General"_s);
    };
    EXPECT_EQ(run({u"Login"_s}), 1);  // no settings
    ASSERT_EQ(run({u"init"_s, book()}), 0);
    ASSERT_EQ(run({u"register"_s, u"--undo"_s}), 0);
    EXPECT_FALSE(isRegistered());
    EXPECT_EQ(run({u"login"_s}), 0) << errors_.toStdString();
    EXPECT_TRUE(isRegistered());
    ASSERT_EQ(run({u"register"_s, u"--undo"_s}), 0);
    EXPECT_EQ(run({u"register"_s}), 0) << errors_.toStdString();
    EXPECT_TRUE(isRegistered());
}

TEST_F(Program, CarriesABookToAServerAndWorksThere) {
    ASSERT_EQ(run({u"init"_s, u"--sample"_s, book()}), 0);
    const host::BookSettings sample{{.dtUser = u"zelmars"_s,
                                     .dtInitialCatalog = u"zelmars"_s,
                                     .dtDataSource = u"sqlite:"_s + book()}};
    EXPECT_TRUE(host::MovementBook(sample).isSample());
    const QString server = u"postgresql:"_s + support::Server::instance().folder();
    const QString admin = QString::fromLatin1(support::Server::User);
    ASSERT_EQ(
        run({u"init"_s, u"--server"_s, server, u"--catalog"_s, u"casa"_s, u"--admin"_s, admin}), 0)
        << errors_.toStdString();
    const QStringList copy{u"copy"_s, u"--admin"_s, admin, u"sqlite:"_s + book() + u"/zelmars"_s,
                           server + u"/casa"_s};
    EXPECT_EQ(run(copy), 0) << errors_.toStdString();
    EXPECT_EQ(run(copy), 1);
    EXPECT_TRUE(errors_.contains(u"não está vazio"_s)) << errors_.toStdString();
    ASSERT_EQ(run({u"register"_s}), 0);
    EXPECT_EQ(run({u"Login"_s}), 0) << errors_.toStdString();
}
