// SPDX-License-Identifier: MIT
#pragma once

#include <sys/types.h>

#include <QString>

struct sqlite3;

namespace ado::sqlite {

/// Which file lies at a path; 0 for none.
struct FileIdentity {
    quint64 device = 0;
    quint64 inode = 0;
    bool operator==(const FileIdentity&) const = default;
};

/// The file of a book and the journal beside it, as a session opened them. Open handles follow the
/// file and not its name: when somebody removes a book or puts a copy in its place, they go on
/// reading and writing a file that nobody will ever open again.
class BookFile {
public:
    explicit BookFile(const QString& path) : path_(path) {}

    const QString& path() const { return path_; }

    /// False when the rights of the system keep this user from writing the book or its folder,
    /// which also holds the journal.
    bool isOpenToUser() const;
    /// To be asked before anything of the book is read, which would bring the journal's pages into
    /// it. Fails when there is a journal that was written for another file than the one that lies
    /// there now. A journal that a crash left beside its own book passes.
    void refuseForeignJournal() const;
    /// Remembers the book and the journal that an open handle has read, also for whoever opens the
    /// book next.
    void remember(sqlite3* handle);
    /// Fails when book or journal are no longer the ones remembered.
    void refuseChanged() const;
    /// The same, and when the handle was opened on another file.
    void refuseChanged(sqlite3* handle) const;

private:
    QString path_;
    FileIdentity book_;
    FileIdentity journal_;
};

/// What whoever lacks the right to write a book is told.
QString noRightText(const QString& book);

}  // namespace ado::sqlite
