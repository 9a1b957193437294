// SPDX-License-Identifier: MIT
#include <grp.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "database/Book.h"
#include "platform/ado/Connection.h"
#include "platform/ado/Recordset.h"
#include "platform/ado/sqlite/BulkAccess.h"
#include "platform/core/Failure.h"
#include "platform/registry/Registry.h"
#include "tests/support/Book.h"

using namespace Qt::StringLiterals;

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

ado::RecordsetPtr hospitalsOf(const QString& folder) {
    const auto connection = std::make_shared<ado::Connection>();
    connection->ConnectionString = u"Initial Catalog=zelmars;Data Source=sqlite:"_s + folder;
    connection->Open();
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(u"select * from tbHospitais"_s, connection, ado::adOpenStatic,
               ado::adLockPessimistic, ado::adCmdUnknown);
    return rows;
}

mode_t modeOf(const QString& path) {
    struct stat facts {};
    EXPECT_EQ(::stat(QFile::encodeName(path).constData(), &facts), 0) << qPrintable(path);
    return facts.st_mode & 07777;
}

/// What the action says when another user of the system does it.
QString asUser(uid_t user, gid_t group, const std::function<QString()>& action) {
    int ends[2] = {};
    EXPECT_EQ(::pipe(ends), 0);
    const pid_t child = ::fork();
    if (child == 0) {
        const bool isOther =
            ::setgroups(0, nullptr) == 0 && ::setgid(group) == 0 && ::setuid(user) == 0;
        const QByteArray said = isOther ? action().toUtf8() : QByteArray("still the same user");
        const bool isSaid = ::write(ends[1], said.constData(), std::size_t(said.size())) >= 0;
        ::_exit(isSaid ? 0 : 1);
    }
    ::close(ends[1]);
    QFile reader;
    EXPECT_TRUE(reader.open(ends[0], QFile::ReadOnly, QFile::AutoCloseHandle));
    const QByteArray said = reader.readAll();
    int status = 0;
    ::waitpid(child, &status, 0);
    EXPECT_EQ(status, 0);
    return QString::fromUtf8(said);
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

TEST_F(BookFile, AFolderThatTheSettingsCannotNameIsRefusedBeforeAnythingIsMade) {
    const QString parent = path("book");
    for (const QString& name : {u"a;b"_s, u"fim "_s, u"fim\u00a0"_s, u"a\tb"_s, u"a\nb"_s,
                                u"\u0001"_s, QString(230, u'x'), u"x/"_s.repeated(130)}) {
        const QString folder = parent + u'/' + name;
        EXPECT_TRUE(failureOf([&] {
                        database::initBook(folder, false);
                    }).contains(u"não a saberiam dizer"_s))
            << qPrintable(name);
        EXPECT_FALSE(QFile::exists(parent)) << qPrintable(name);
    }
    // What can be named is found again by a login.
    for (const QString& name : {u"a'b\"c"_s, u"=x, y%20 @(z)"_s, u"barra\\t"_s, u"Ação €"_s}) {
        database::initBook(parent + u'/' + name, false);
        const auto key =
            registry::Key::open(registry::Hive::LocalMachine, u"SOFTWARE\\Norvanta\\Corvenda"_s);
        ado::Connection connection;
        connection.ConnectionString =
            u"Initial Catalog=zelmars;Data Source="_s + key->value(u"dtDataSource"_s).value();
        EXPECT_EQ(failureOf([&] { connection.Open(); }), QString());
    }
}

TEST_F(BookFile, BelongsToItsMakerOrToAGroupWhateverTheUmask) {
    const QByteArray group = ::getgrgid(::getegid())->gr_name;
    const struct {
        const char* folder;
        database::BookOwners owners;
        mode_t folderMode;
        mode_t fileMode;
    } cases[] = {{"own", {}, 0700, 0600},
                 {"group", database::BookOwners(QString::fromLocal8Bit(group)), 02770, 0660}};
    for (const mode_t mask : {mode_t{0}, mode_t{0277}})
        for (const auto& each : cases) {
            const mode_t before = ::umask(mask);
            QDir(path(each.folder)).removeRecursively();
            database::initBook(path(each.folder), false, each.owners);
            const auto rows = hospitalsOf(path(each.folder));
            rows->AddNew();
            rows->Update();
            rows->setCollect(u"nome"_s, u"x"_s);  // holds the row
            ::umask(before);
            EXPECT_EQ(modeOf(path(each.folder)), each.folderMode);
            for (const char* file : {"", "-wal", "-shm", "-locks"})
                EXPECT_EQ(modeOf(path(each.folder) + u"/zelmars.db"_s + QString::fromLatin1(file)),
                          each.fileMode)
                    << each.folder << file;
        }
    EXPECT_TRUE(
        failureOf([] { database::BookOwners(u"nenhum grupo"_s); }).contains(u"«nenhum grupo»"_s));
    // A folder with files in it is not opened to a group behind its owner's back.
    write(path("full"), {});
    QFile::remove(path("full"));
    QDir().mkpath(path("full"));
    write(path("full/x"), "x");
    EXPECT_TRUE(failureOf([&] {
                    database::initBook(path("full"), false, cases[1].owners);
                }).contains(u"chmod 2770"_s));
}

TEST_F(BookFile, AUserWithoutTheRightIsToldSoAndAMemberOfTheGroupWorks) {
    if (::geteuid() != 0) GTEST_SKIP() << "only the administrator can become another user";
    constexpr gid_t Group = 60017;
    QFile::setPermissions(path("."), QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner |
                                         QFile::ExeGroup | QFile::ExeOther);
    database::initBook(path("book"), false, database::BookOwners(u"nogroup"_s));
    const QString file = path("book/zelmars.db");
    const auto posting = [&] {
        return failureOf([&] {
            const auto rows = hospitalsOf(path("book"));
            rows->AddNew();
            rows->Update();
        });
    };
    EXPECT_EQ(asUser(60018, 65534, posting), QString());
    const QString refused = asUser(60017, Group, posting);
    EXPECT_TRUE(refused.startsWith(u"Não tem direito de escrever"_s)) << qPrintable(refused);
    // Who may only read reads, and is told when he writes.
    ::chmod(QFile::encodeName(path("book")).constData(), 0755);
    const auto kept = hospitalsOf(path("book"));
    for (const char* suffix : {"", "-wal", "-shm"})
        ::chmod((QFile::encodeName(file) + suffix).constData(), 0644);
    EXPECT_TRUE(asUser(60017, Group, posting).startsWith(refused));
    EXPECT_EQ(asUser(60017, Group, [&] { return failureOf([&] { hospitalsOf(path("book")); }); }),
              QString());
    EXPECT_EQ(kept->RecordCount(), 1);
}

TEST_F(BookFile, ABookInUseOrWithMembersIsNotFilled) {
    support::Book book;
    book.count(u"tbSocios"_s);  // whoever has read it holds it open
    const auto fill = [&] { database::fillSample(book.folder(), book.catalogue()); };
    const QString inUse = failureOf(fill);
    EXPECT_TRUE(inUse.startsWith(u"Outro posto ou outro programa"_s)) << qPrintable(inUse);
    EXPECT_TRUE(inUse.endsWith(u"Pormenores: database is locked"_s)) << qPrintable(inUse);
    book.member({});
    EXPECT_TRUE(failureOf(fill).contains(u"já tem associados"_s));
    EXPECT_EQ(book.text(u"select count(*) from tbZelmar_Plafonds"_s), u"0"_s);
    EXPECT_EQ(book.text(u"pragma journal_mode"_s), u"wal"_s);
}

TEST_F(BookFile, AFillingThatFailsHalfWayLeavesTheBookEmptyAndReady) {
    database::createBook(path("book"), u"zelmars"_s);
    const QString file = database::bookFile(path("book"), u"zelmars"_s);
    ado::sqlite::BulkAccess(file).execute(
        "create trigger stop before insert on tbSocios_Acumulados begin "
        "select raise(abort, 'no room'); end");
    EXPECT_EQ(failureOf([&] { database::fillSample(path("book"), u"zelmars"_s); }), u"no room"_s);
    ado::sqlite::BulkAccess book(file);
    EXPECT_EQ(book.number("select count(*) from tbSocios"), 0);
    EXPECT_EQ(book.number("select count(*) from tbZelmar_Movimentos_Historico"), 0);
    EXPECT_EQ(book.number("select zelmars from tbContadores"), 1);
    EXPECT_EQ(book.number("select journal_mode = 'wal' from pragma_journal_mode"), 1);
}

}  // namespace
