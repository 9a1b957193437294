// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/BookFile.h"

#include <sqlite3.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <QFileInfo>
#include <cerrno>
#include <optional>

#include "platform/ado/sqlite/SideFile.h"
#include "platform/core/Failure.h"

namespace ado::sqlite {

using namespace Qt::StringLiterals;

namespace {

/// Where the side file keeps what was opened last: behind the records of who holds which row, and
/// far before the rows themselves.
constexpr off_t OpenedAt = off_t{1} << 20;

struct Opened {
    FileIdentity book;
    FileIdentity journal;
    bool operator==(const Opened&) const = default;
};

std::optional<struct stat> factsOf(const QString& path) {
    struct stat facts {};
    if (::stat(QFile::encodeName(path).constData(), &facts) != 0) return std::nullopt;
    return facts;
}

FileIdentity identityOf(const QString& path) {
    const auto facts = factsOf(path);
    if (!facts) return {};
    return {facts->st_dev, facts->st_ino};
}

QString journalOf(const QString& book) {
    return book + u"-wal"_s;
}

core::Failure refusal(const QString& text) {
    return {core::DatabaseFailure, text};
}

/// Nothing where the side file cannot be opened: whoever may not write a book may still read it.
Opened openedLast(const QString& book) {
    Opened opened;
    try {
        const SideFile side(book);
        if (::pread(side.descriptor(), &opened, sizeof opened, OpenedAt) == sizeof opened)
            return opened;
    } catch (const core::Failure&) {
        // Told to whoever is about to write, by the lock of the row.
    }
    return {};
}

void writeDown(const QString& book, const Opened& opened) {
    if (openedLast(book) == opened) return;
    try {
        const SideFile side(book);
        // It counts after a power cut, when somebody puts a copy in place of the book.
        if (::pwrite(side.descriptor(), &opened, sizeof opened, OpenedAt) == sizeof opened)
            ::fdatasync(side.descriptor());
    } catch (const core::Failure&) {
        // As above.
    }
}

bool hasMoved(sqlite3* handle) {
    int moved = 0;
    return sqlite3_file_control(handle, "main", SQLITE_FCNTL_HAS_MOVED, &moved) == SQLITE_OK &&
           moved != 0;
}

}  // namespace

QString noRightText(const QString& book) {
    return u"Não tem direito de escrever no livro «%1» ou na pasta dele. Peça a quem o fez, ou ao "
           "administrador, que o junte ao grupo do livro. Um livro para os membros de um grupo "
           "faz-se com: zelmars init --group GRUPO PASTA"_s.arg(book);
}

bool BookFile::isOpenToUser() const {
    const QByteArray book = QFile::encodeName(path_);
    const QByteArray folder = QFile::encodeName(QFileInfo(path_).path());
    return (::euidaccess(book.constData(), R_OK | W_OK) == 0 &&
            ::euidaccess(folder.constData(), W_OK | X_OK) == 0) ||
           (errno != EACCES && errno != EROFS);
}

void BookFile::refuseForeignJournal() const {
    const auto book = factsOf(path_);
    const auto journal = factsOf(journalOf(path_));
    if (!book || !journal || journal->st_size == 0) return;
    const Opened last = openedLast(path_);
    // The times of the two files tell nothing: a journal that is carried over long after the last
    // posting, and cut off in that, is older than its own book.
    if (last.journal != FileIdentity{journal->st_dev, journal->st_ino} ||
        last.book == FileIdentity{book->st_dev, book->st_ino})
        return;
    throw refusal(
        u"O diário «%1-wal» não pertence ao livro «%1»: o livro foi reposto ou substituído e o "
        "diário do anterior ficou. Nada foi alterado.\n\nFeche o programa em todas as janelas, "
        "mude «%1-wal» e «%1-shm» para outra pasta e abra o livro de novo. O que foi lançado "
        "depois da cópia reposta terá de ser lançado outra vez."_s.arg(path_));
}

void BookFile::remember(sqlite3* handle) {
    book_ = identityOf(path_);
    journal_ = identityOf(journalOf(path_));
    // The handle's own file is the one at the path, and so the one that was just looked at.
    refuseChanged(handle);
    writeDown(path_, {book_, journal_});
}

void BookFile::refuseChanged() const {
    const FileIdentity book = identityOf(path_);
    if (book == book_ && (journal_.inode == 0 || identityOf(journalOf(path_)) == journal_)) return;
    const QString what = book == FileIdentity{} ? u"foi apagado ou mudado de sítio"_s
                         : book == book_        ? u"ficou sem o seu diário «-wal»"_s
                                                : u"foi substituído por outro ficheiro"_s;
    throw refusal(
        u"O livro «%1» %2 enquanto estava aberto. Nada foi gravado.\n\nFeche o programa em todas "
        "as janelas, confirme que o livro certo está no seu lugar e abra-o de novo. Procure nele "
        "os últimos lançamentos antes de os repetir."_s.arg(path_, what));
}

void BookFile::refuseChanged(sqlite3* handle) const {
    refuseChanged();
    if (hasMoved(handle))
        throw refusal(
            u"O livro «%1» foi substituído enquanto se abria. Tente de novo."_s.arg(path_));
}

}  // namespace ado::sqlite
