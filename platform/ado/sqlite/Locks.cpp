// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Locks.h"

#include <fcntl.h>
#include <unistd.h>

#include <QElapsedTimer>
#include <QThread>
#include <algorithm>
#include <cerrno>
#include <cstring>

#include "platform/ado/engine/EngineTexts.h"
#include "platform/ado/engine/RowHolders.h"
#include "platform/ado/sqlite/SideFile.h"
#include "platform/core/Failure.h"
#include "platform/core/Wait.h"

namespace ado::sqlite {

using namespace Qt::StringLiterals;

namespace {

// The first part of the side file has a record for each of these many slots; rows are locked far
// behind it.
constexpr quint64 Slots = 4096;
constexpr std::size_t OwnerLength = 120;  // bytes, zero-filled
constexpr quint64 FirstRow = quint64{1} << 40;

struct Record {
    quint64 offset = 0;  ///< the row that was locked; another row may have the same slot
    char owner[OwnerLength] = {};
};

/// Milliseconds between two looks at a row that somebody holds. A number is drawn in less.
constexpr unsigned long LongestPause = 4;

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

class OfdLock final : public RowLock {
public:
    OfdLock(const QString& book, quint64 offset)
        : file_(book), offset_(offset), here_(book, QString::number(offset)) {}

    bool heldByThisThread() const { return here_.isTaken(); }

    bool take() {
        struct flock range {};
        range.l_type = F_WRLCK;
        range.l_whence = SEEK_SET;
        range.l_start = static_cast<off_t>(offset_);
        range.l_len = 1;
        if (::fcntl(file_.descriptor(), F_OFD_SETLK, &range) != 0) {
            if (errno == EAGAIN || errno == EACCES || errno == EINTR) return false;
            throw core::Failure(
                core::DatabaseFailure,
                u"Não foi possível bloquear a linha: %1"_s.arg(qt_error_string(errno)));
        }
        here_.take();
        Record record;
        record.offset = offset_;
        std::memcpy(
            record.owner, workstation().constData(),
            qMin<std::size_t>(OwnerLength - 1, static_cast<std::size_t>(workstation().size())));
        // Only for the text of a refusal: without it the lock holds all the same.
        [[maybe_unused]] const ssize_t written =
            ::pwrite(file_.descriptor(), &record, sizeof record, slotOf(offset_));
        return true;
    }

    /// Who took the row, as far as the record still tells.
    QString holder() const {
        Record record;
        const bool known =
            ::pread(file_.descriptor(), &record, sizeof record, slotOf(offset_)) == sizeof record &&
            record.offset == offset_;
        record.owner[OwnerLength - 1] = '\0';
        return known ? QString::fromUtf8(record.owner) : OtherWorkstation;
    }

private:
    SideFile file_;
    quint64 offset_;
    HeldHere here_;
};

}  // namespace

std::unique_ptr<RowLock> Locks::lock(const QString& table, RowIdentity row,
                                     int timeoutSeconds) const {
    auto lock = std::make_unique<OfdLock>(book_, offsetOf(table, row));
    if (lock->heldByThisThread()) refuseRow(table, row, OtherWindow);
    if (lock->take()) return lock;
    QElapsedTimer waited;
    waited.start();
    core::Wait waiting(waitsForRow(lock->holder()));
    for (unsigned long pause = 1; !lock->take(); pause = qMin(pause * 2, LongestPause)) {
        if (waited.hasExpired(qint64{timeoutSeconds} * 1000)) refuseRow(table, row, lock->holder());
        if (!waiting.goesOn()) throw givenUp();
        QThread::msleep(pause);
    }
    return lock;
}

}  // namespace ado::sqlite
