// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "database/Book.h"
#include "database/Sqlite.h"
#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"
#include "tests/support/Book.h"

using namespace Qt::StringLiterals;

namespace sqlite = database::sqlite;

namespace {

/// The text of the failure; empty when there was none.
template <class Call>
QString failureOf(Call&& call) {
    try {
        call();
    } catch (const core::Failure& failure) {
        return failure.text();
    }
    return {};
}

QByteArray bytesOf(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("unreadable");
}

void write(const QString& path, const QByteArray& bytes) {
    QFile file(path);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write(bytes);
}

class BookFile : public testing::Test {
protected:
    void SetUp() override { qputenv("ZELMARS_REGISTRY", path("registry").toUtf8()); }
    void TearDown() override { qputenv("ZELMARS_REGISTRY", registryBefore_); }

    QString path(const char* name) const { return root_.filePath(QString::fromLatin1(name)); }

private:
    QTemporaryDir root_;
    QByteArray registryBefore_ = qgetenv("ZELMARS_REGISTRY");
};

TEST_F(BookFile, AnExistingFileIsNotTouchedWhateverItHolds) {
    for (const QByteArray& content : {QByteArray(), QByteArray("not a database")}) {
        QDir().mkpath(path("book"));
        const QString file = database::bookFile(path("book"), u"zelmars"_s);
        write(file, content);
        const QString failure = failureOf([&] { database::initBook(path("book"), true); });
        EXPECT_TRUE(failure.contains(u"Já existe"_s) && failure.contains(file))
            << qPrintable(failure);
        EXPECT_EQ(bytesOf(file), content);
        EXPECT_EQ(QDir(path("book")).entryList(QDir::Files), QStringList{u"zelmars.db"_s});
        EXPECT_FALSE(QFile::exists(path("registry"))) << "the settings were written";
    }
}

TEST_F(BookFile, ARefusedSettingLeavesNeitherBookNorFolder) {
    registry::writeValue(registry::Hive::LocalMachine, u"SOFTWARE"_s, u"x"_s, u"1"_s);
    const QString hive = path("registry/HKEY_LOCAL_MACHINE.ini");
    QFile::setPermissions(hive, QFile::ReadOwner | QFile::WriteOwner | QFile::ReadOther);
    EXPECT_NE(failureOf([&] { database::initBook(path("book"), true); }), QString());
    EXPECT_FALSE(QFile::exists(path("book")));
    // Nor does a folder that cannot be made; it is told by its name.
    write(path("file"), "in the way");
    const QString failure = failureOf([&] { database::initBook(path("file/book"), false); });
    EXPECT_TRUE(failure.contains(path("file/book"))) << qPrintable(failure);
}

TEST_F(BookFile, ABookInUseOrWithMembersIsNotFilled) {
    support::Book book;
    book.count(u"tbSocios"_s);  // whoever has read it holds it open
    const auto fill = [&] { database::fillSample(book.folder(), book.catalogue()); };
    EXPECT_EQ(failureOf(fill), u"database is locked"_s);
    book.member({});
    EXPECT_TRUE(failureOf(fill).contains(u"já tem associados"_s));
    EXPECT_EQ(book.text(u"select count(*) from tbZelmar_Plafonds"_s), u"0"_s);
    EXPECT_EQ(book.text(u"pragma journal_mode"_s), u"wal"_s);
}

TEST_F(BookFile, AFillingThatFailsHalfWayLeavesTheBookEmptyAndReady) {
    database::createBook(path("book"), u"zelmars"_s);
    const QString file = database::bookFile(path("book"), u"zelmars"_s);
    using sqlite::Database;
    Database(file, Database::Mode::OpenExisting)
        .run(
            "create trigger stop before insert on tbSocios_Acumulados begin "
            "select raise(abort, 'no room'); end");
    EXPECT_EQ(failureOf([&] { database::fillSample(path("book"), u"zelmars"_s); }), u"no room"_s);
    Database book(file, Database::Mode::OpenExisting);
    EXPECT_EQ(book.number("select count(*) from tbSocios"), 0);
    EXPECT_EQ(book.number("select count(*) from tbZelmar_Movimentos_Historico"), 0);
    EXPECT_EQ(book.number("select zelmars from tbContadores"), 1);
    EXPECT_EQ(book.number("select journal_mode = 'wal' from pragma_journal_mode"), 1);
}

}  // namespace
