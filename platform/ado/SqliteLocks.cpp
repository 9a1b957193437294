// SPDX-License-Identifier: MIT
#include "platform/ado/SqliteLocks.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QElapsedTimer>
#include <QFile>
#include <QSysInfo>
#include <QThread>
#include <algorithm>
#include <cerrno>
#include <cstring>

#include "platform/core/Failure.h"
#include "platform/core/UserName.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

// The file's first part has a record for each of these many slots; rows are locked far behind it.
constexpr quint64 Slots = 4096;
constexpr std::size_t OwnerLength = 120;  // bytes, zero-filled
constexpr quint64 FirstRow = quint64{1} << 40;

struct Record {
    quint64 offset = 0;  ///< the row that was locked; another row may have the same slot
    char owner[OwnerLength] = {};
};

/// A place in the file for a row of a table; the same in every process.
quint64 offsetOf(const QString& table, RowIdentity row) {
    quint64 hash = 14695981039346656037ULL;  // FNV-1a
    const auto mix = [&](quint64 value, int bytes) {
        for (; bytes > 0; --bytes, value >>= 8) hash = (hash ^ (value & 0xFF)) * 1099511628211ULL;
    };
    for (const QChar c : table) mix(c.toLower().unicode(), 2);
    mix(static_cast<quint64>(row), 8);
    return FirstRow + (hash >> 2);
}

off_t slotOf(quint64 offset) {
    return static_cast<off_t>(offset % Slots * sizeof(Record));
}

const QByteArray& self() {
    static const QByteArray owner = [] {
        char name[OwnerLength / 2] = {};
        if (!core::userName(name, sizeof name - 1)) std::strcpy(name, "?");
        return QByteArray(name) + '@' + QSysInfo::machineHostName().toUtf8();
    }();
    return owner;
}

/// Rows that this thread holds: file and place.
struct Held {
    QString path;
    quint64 offset;
    bool operator==(const Held&) const = default;
};
thread_local std::vector<Held> heldHere;

class OfdLock final : public RowLock {
public:
    OfdLock(const QString& path, quint64 offset) : held_{path, offset} {
        const QByteArray name = QFile::encodeName(path);
        // Not inherited by a program that this one starts: it would keep the row.
        file_ = ::open(name.constData(), O_RDWR | O_CLOEXEC);
        if (file_ < 0 && errno == ENOENT) file_ = makeLike(name);
        if (file_ < 0)
            throw core::Failure(core::DatabaseFailure,
                                u"Não foi possível abrir o ficheiro de bloqueios «%1»: %2"_s.arg(
                                    path, qt_error_string(errno)));
    }
    ~OfdLock() override {
        if (taken_) heldHere.erase(std::find(heldHere.begin(), heldHere.end(), held_));
        if (file_ >= 0) ::close(file_);
    }
    OfdLock(const OfdLock&) = delete;
    OfdLock& operator=(const OfdLock&) = delete;

    bool heldByThisThread() const {
        return std::find(heldHere.begin(), heldHere.end(), held_) != heldHere.end();
    }

    bool take() {
        struct flock range {};
        range.l_type = F_WRLCK;
        range.l_whence = SEEK_SET;
        range.l_start = static_cast<off_t>(held_.offset);
        range.l_len = 1;
        if (::fcntl(file_, F_OFD_SETLK, &range) != 0) {
            if (errno == EAGAIN || errno == EACCES || errno == EINTR) return false;
            throw core::Failure(
                core::DatabaseFailure,
                u"Não foi possível bloquear a linha: %1"_s.arg(qt_error_string(errno)));
        }
        taken_ = true;
        heldHere.push_back(held_);
        Record record;
        record.offset = held_.offset;
        std::memcpy(record.owner, self().constData(),
                    qMin<std::size_t>(OwnerLength - 1, static_cast<std::size_t>(self().size())));
        // Only for the text of a refusal: without it the lock holds all the same.
        [[maybe_unused]] const ssize_t written =
            ::pwrite(file_, &record, sizeof record, slotOf(held_.offset));
        return true;
    }

    /// Who took the row, as far as the record still tells.
    QString holder() const {
        Record record;
        const bool known =
            ::pread(file_, &record, sizeof record, slotOf(held_.offset)) == sizeof record &&
            record.offset == held_.offset;
        record.owner[OwnerLength - 1] = '\0';
        return known ? QString::fromUtf8(record.owner) : u"outro posto"_s;
    }

private:
    /// Makes the file with the book's own mode, so that whoever may write the book may lock.
    static int makeLike(const QByteArray& name) {
        struct stat book {};
        ::stat(name.chopped(static_cast<qsizetype>(std::strlen("-locks"))).constData(), &book);
        const mode_t mode = book.st_mode & 0666;
        const int file = ::open(name.constData(), O_RDWR | O_CREAT | O_CLOEXEC, mode);
        if (file >= 0) ::fchmod(file, mode);
        return file;
    }

    Held held_;
    int file_ = -1;
    bool taken_ = false;
};

[[noreturn]] void refuse(const QString& table, RowIdentity row, const QString& holder) {
    throw core::Failure(
        core::RowInUse,
        u"A linha %1 de %2 está a ser usada por %3. Tente mais tarde."_s.arg(row).arg(table,
                                                                                      holder));
}

}  // namespace

std::unique_ptr<RowLock> SqliteLocks::lock(const QString& table, RowIdentity row,
                                           int timeoutSeconds) const {
    auto lock = std::make_unique<OfdLock>(path_, offsetOf(table, row));
    if (lock->heldByThisThread()) refuse(table, row, u"outra janela deste programa"_s);
    QElapsedTimer waited;
    waited.start();
    for (unsigned long pause = 1; !lock->take(); pause = qMin(pause * 2, 50UL)) {
        if (waited.hasExpired(qint64{timeoutSeconds} * 1000)) refuse(table, row, lock->holder());
        QThread::msleep(pause);
    }
    return lock;
}

}  // namespace ado
