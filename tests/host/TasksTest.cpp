// SPDX-License-Identifier: MIT
// The program itself, started as a person starts it.
#include <gtest/gtest.h>

#include <QProcess>
#include <QTemporaryDir>

#include "tests/support/Server.h"

using namespace Qt::StringLiterals;

namespace {

/// The program with settings of its own, in a temporary folder.
class Program : public testing::Test {
protected:
    int run(const QStringList& words) {
        QProcess program;
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert(u"ZELMARS_REGISTRY"_s, folder_.filePath(u"registry"_s));
        environment.insert(u"ZELMARS_USER_PASSWORD"_s, u"segredo"_s);
        program.setProcessEnvironment(environment);
        program.start(QCoreApplication::applicationDirPath() + u"/zelmars"_s, words);
        EXPECT_TRUE(program.waitForFinished(60'000));
        errors_ = QString::fromUtf8(program.readAllStandardError());
        return program.exitCode();
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

TEST_F(Program, LogsInThroughTheRegisteredComponent) {
    EXPECT_EQ(run({u"Login"_s}), 1);  // nothing is registered
    EXPECT_EQ(run({u"register"_s}), 0) << errors_.toStdString();
    EXPECT_EQ(run({u"Login"_s}), 1);  // no settings
    ASSERT_EQ(run({u"init"_s, book()}), 0);
    EXPECT_EQ(run({u"login"_s}), 0) << errors_.toStdString();
    EXPECT_EQ(run({u"register"_s, u"--undo"_s}), 0);
    EXPECT_EQ(run({u"Login"_s}), 1);
}

TEST_F(Program, CarriesABookToAServerAndWorksThere) {
    ASSERT_EQ(run({u"init"_s, u"--sample"_s, book()}), 0);
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
