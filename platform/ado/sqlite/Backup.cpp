// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Backup.h"

#include <sqlite3.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QFile>
#include <QFileInfo>
#include <QSet>

#include "platform/ado/sqlite/BookFile.h"
#include "platform/core/Failure.h"
#include "platform/core/NewFile.h"

namespace ado::sqlite {

using namespace Qt::StringLiterals;

namespace {

constexpr int Patience = 30'000;    // milliseconds
constexpr int PagesOfAStep = 4096;  // between two of them others may write

/// Every program that has a book open holds this byte of the file `BOOK-shm` for reading.
constexpr auto OpenByte = "128";

core::Failure failure(sqlite3* handle, const QString& what) {
    return {core::DatabaseFailure, what + u' ' + QString::fromUtf8(sqlite3_errmsg(handle)),
            QString::number(sqlite3_extended_errcode(handle))};
}

/// A database while it is copied or looked at.
class Opened {
public:
    Opened(const QString& file, int flags, const QString& what) : what_(what) {
        const int result =
            sqlite3_open_v2(QFile::encodeName(file).constData(), &handle_, flags, nullptr);
        sqlite3_busy_timeout(handle_, Patience);
        if (result == SQLITE_OK) return;
        const core::Failure failed = failure(handle_, what_);
        sqlite3_close_v2(handle_);
        throw failed;
    }
    ~Opened() { sqlite3_close_v2(handle_); }
    Opened(const Opened&) = delete;
    Opened& operator=(const Opened&) = delete;

    sqlite3* get() const { return handle_; }
    void execute(const char* text) const {
        if (sqlite3_exec(handle_, text, nullptr, nullptr, nullptr) != SQLITE_OK)
            throw failure(handle_, what_);
    }
    /// All rows of one column.
    QStringList texts(const char* query) const {
        QStringList found;
        const auto add = [](void* into, int, char** row, char**) {
            static_cast<QStringList*>(into)->append(QString::fromUtf8(row[0]));
            return 0;
        };
        if (sqlite3_exec(handle_, query, add, &found, nullptr) != SQLITE_OK)
            throw failure(handle_, what_);
        return found;
    }

private:
    sqlite3* handle_ = nullptr;
    QString what_;
};

void copy(const Opened& from, const Opened& into, const QString& what) {
    sqlite3_backup* const backup = sqlite3_backup_init(into.get(), "main", from.get(), "main");
    if (!backup) throw failure(into.get(), what);
    int result = SQLITE_OK;
    while (result == SQLITE_OK) result = sqlite3_backup_step(backup, PagesOfAStep);
    sqlite3_backup_finish(backup);
    if (result != SQLITE_DONE) throw failure(into.get(), what);
}

/// The program and its user, as far as the system tells them.
QString nameOf(const QString& process) {
    QFile comm(u"/proc/%1/comm"_s.arg(process));
    if (!comm.open(QIODevice::ReadOnly)) return u"outro programa"_s;
    const QString program = QString::fromUtf8(comm.readAll()).trimmed();
    const QString user = QFileInfo(u"/proc/%1"_s.arg(process)).owner();
    return user.isEmpty() ? program : u"%1 (%2)"_s.arg(user, program);
}

}  // namespace

void backUp(const QString& book, const QString& file) {
    const QString what = u"Não foi possível fazer a cópia de segurança «%1»."_s.arg(file);
    const core::NewFile made(file, what);
    {
        BookFile(book).refuseForeignJournal();
        const Opened from(book, SQLITE_OPEN_READWRITE, what);
        const Opened into(made.staged(), SQLITE_OPEN_READWRITE, what);
        copy(from, into, what);
        // One file, without others beside it.
        into.execute("PRAGMA journal_mode=DELETE");
    }
    made.commit();
}

void prove(const QString& file, const QStringList& tables) {
    const QString what = u"«%1» não é uma cópia de segurança inteira de um livro."_s.arg(file);
    const Opened opened(file, SQLITE_OPEN_READONLY, what);
    const QStringList faults = opened.texts("PRAGMA integrity_check(1)");
    if (faults != QStringList{u"ok"_s})
        throw core::Failure(core::DatabaseFailure, what + u' ' + faults.value(0));
    const QStringList known =
        opened.texts("SELECT lower(name) FROM sqlite_schema WHERE type = 'table'");
    for (const QString& table : tables)
        if (!known.contains(table.toLower()))
            throw core::Failure(core::DatabaseFailure, what + u" Falta a tabela %1."_s.arg(table));
}

qint64 numberIn(const QString& file, const QString& table, const QString& column) {
    const QString what = u"Não foi possível ler a cópia de segurança «%1»."_s.arg(file);
    const Opened opened(file, SQLITE_OPEN_READONLY, what);
    const QStringList known = opened.texts("SELECT lower(name) FROM sqlite_schema");
    if (!known.contains(table)) return 0;
    return opened.texts(u"SELECT %1 FROM %2 LIMIT 1"_s.arg(column, table).toUtf8().constData())
        .value(0)
        .toLongLong();
}

void restore(const QString& file, const QString& book) {
    const QString what = u"Não foi possível repor o livro «%1»."_s.arg(book);
    const Opened from(file, SQLITE_OPEN_READONLY, what);
    const Opened into(book, SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE, what);
    into.execute("PRAGMA synchronous=FULL");
    copy(from, into, what);
}

QStringList othersIn(const QString& book) {
    struct stat facts {};
    if (::stat(QFile::encodeName(book + u"-shm"_s).constData(), &facts) != 0) return {};
    QFile locks(u"/proc/locks"_s);
    if (!locks.open(QIODevice::ReadOnly)) return {};
    // "1: POSIX  ADVISORY  READ 4711 fe:00:131073 128 128"
    const QByteArray inode = QByteArray::number(static_cast<qulonglong>(facts.st_ino));
    QSet<QString> others;
    for (const QByteArray& line : locks.readAll().split('\n')) {
        const QList<QByteArray> words = line.simplified().split(' ');
        if (words.size() < 8 || words[1] != "POSIX" || words[6] != OpenByte ||
            words[5].split(':').last() != inode)
            continue;
        const QString process = QString::fromLatin1(words[4]);
        if (process != QString::number(::getpid())) others.insert(process);
    }
    QStringList names;
    for (const QString& process : others) names << nameOf(process);
    names.sort();
    return names;
}

}  // namespace ado::sqlite
