// SPDX-License-Identifier: MIT
// Disks that fail while a book in a file is written.
#include <sqlite3.h>

#include <map>

#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

/// The engine's files as long as it lives, with a disk that fails when told so.
class BadDisk {
public:
    BadDisk() : vfs_(*sqlite3_vfs_find(nullptr)) {
        plain = sqlite3_vfs_find(nullptr);
        vfs_.zName = "bad";
        vfs_.xOpen = [](sqlite3_vfs*, const char* name, sqlite3_file* file, int flags, int* out) {
            const int result = plain->xOpen(plain, name, file, flags, out);
            if (result != SQLITE_OK) return result;
            // Books and journals have methods of their own, which write and synchronise alike.
            genuine = file->pMethods;
            sqlite3_io_methods& failing = methods.try_emplace(genuine, *genuine).first->second;
            failing.xWrite = [](sqlite3_file* at, const void* bytes, int size, sqlite3_int64 from) {
                return atWriting ? atWriting : genuine->xWrite(at, bytes, size, from);
            };
            failing.xSync = [](sqlite3_file* at, int how) {
                return atSync ? atSync : genuine->xSync(at, how);
            };
            file->pMethods = &failing;
            return SQLITE_OK;
        };
        sqlite3_vfs_register(&vfs_, 1);
    }
    ~BadDisk() {
        atWriting = atSync = SQLITE_OK;
        sqlite3_vfs_unregister(&vfs_);
        sqlite3_vfs_register(plain, 1);
    }
    BadDisk(const BadDisk&) = delete;
    BadDisk& operator=(const BadDisk&) = delete;

    static inline int atWriting = SQLITE_OK;  ///< what writing fails with
    static inline int atSync = SQLITE_OK;

private:
    static inline sqlite3_vfs* plain = nullptr;
    static inline const sqlite3_io_methods* genuine = nullptr;
    static inline std::map<const sqlite3_io_methods*, sqlite3_io_methods> methods;
    sqlite3_vfs vfs_;
};

class Disks : public SmallBook {
protected:
    void SetUp() override {
        if (support::onServer()) GTEST_SKIP() << "the server has the disk";
        fill(2);
    }
    /// The texts of an added, a changed and a deleted row that fail.
    QStringList failingWrites(int& where, int code) {
        const auto own = connect();
        const auto rows = open(u"select * from tbMov"_s, own, ado::adLockOptimistic);
        const auto failing = [&](const auto& write) {
            where = code;
            const QString text = failureOf(write).text();
            where = SQLITE_OK;
            return text;
        };
        QStringList texts;
        rows->setCollect(u"nome"_s, u"b"_s);
        rows->Update();
        rows->setCollect(u"nome"_s, u"c"_s);
        texts << failing([&] { rows->Update(); });
        rows->CancelUpdate();
        texts << failing([&] { rows->Delete(); });
        rows->AddNew();
        rows->setCollect(u"nome"_s, u"d"_s);
        texts << failing([&] { rows->Update(); });
        return texts;
    }
};

TEST_F(Disks, ThatDoNotConfirmACommitMakeTheOperatorLook) {
    BadDisk disk;
    for (const QString& text : failingWrites(BadDisk::atSync, SQLITE_IOERR_FSYNC)) {
        EXPECT_TRUE(text.startsWith(u"O disco falhou"_s)) << qPrintable(text);
        EXPECT_TRUE(text.contains(
            u" A linha pode ter ficado gravada: procure-a antes de repetir.\n\nPormenores: "_s))
            << qPrintable(text);
        EXPECT_TRUE(text.endsWith(u"disk I/O error"_s)) << qPrintable(text);
    }
}

TEST_F(Disks, ThatAreFullStoreNothing) {
    BadDisk disk;
    for (const QString& text : failingWrites(BadDisk::atWriting, SQLITE_FULL)) {
        EXPECT_TRUE(text.startsWith(u"O disco está cheio; nada foi gravado."_s))
            << qPrintable(text);
        EXPECT_FALSE(text.contains(u"pode ter ficado"_s)) << qPrintable(text);
        EXPECT_TRUE(text.endsWith(u"database or disk is full"_s)) << qPrintable(text);
    }
    EXPECT_EQ(book.text(u"SELECT nome FROM tbMov ORDER BY id"_s), u"b\nn2"_s);
}

}  // namespace
