// SPDX-License-Identifier: MIT
// Rows held against every other row set and workstation: the server's advisory locks, kept by the
// connection that writes and let go by the server when it ends. Nobody who only reads waits.
#include "platform/ado/engine/RowHolders.h"
#include "platform/ado/postgres/Session.h"
#include "platform/core/Failure.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;

namespace {

// The server makes the 64-bit number of a lock from its key.
constexpr auto Take = "SELECT pg_advisory_lock(hashtextextended($1, 0))";
constexpr auto LetGo = "SELECT pg_advisory_unlock(hashtextextended($1, 0))";
constexpr auto Holder =
    "SELECT a.application_name FROM pg_locks l JOIN pg_stat_activity a USING (pid)"
    " WHERE l.locktype = 'advisory' AND l.granted AND l.objsubid = 1"
    "   AND l.database = (SELECT oid FROM pg_database WHERE datname = current_database())"
    "   AND ((l.classid::bigint << 32) | l.objid::bigint) = hashtextextended($1, 0)";

/// SQLSTATE of a lock that was waited for too long.
constexpr auto LockNotAvailable = "55P03"_L1;

QByteArray keyOf(const QString& table, RowIdentity row) {
    return table.toLower().toUtf8() + ':' + QByteArray::number(row);
}

class AdvisoryLock final : public RowLock {
public:
    AdvisoryLock(std::shared_ptr<Session> session, const QByteArray& key)
        : session_(std::move(session)),
          key_(key),
          here_(session_->book(), QString::fromUtf8(key)) {}
    ~AdvisoryLock() override {
        if (taken_) session_->unlock(key_);
    }
    AdvisoryLock(const AdvisoryLock&) = delete;
    AdvisoryLock& operator=(const AdvisoryLock&) = delete;

    bool isUnbroken() const override { return session_->isHeld(key_); }

    bool heldByThisThread() const { return here_.isTaken(); }
    void taken() {
        taken_ = true;
        here_.take();
    }

private:
    std::shared_ptr<Session> session_;
    QByteArray key_;
    HeldHere here_;
    bool taken_ = false;
};

}  // namespace

std::unique_ptr<RowLock> Session::lock(const QString& table, RowIdentity row, int timeoutSeconds,
                                       RowStore& into) {
    const QByteArray key = keyOf(table, row);
    auto lock = std::make_unique<AdvisoryLock>(shared_from_this(), key);
    if (lock->heldByThisThread()) refuseRow(table, row, OtherWindow);
    setTimeout(timeoutSeconds);
    if (isGathering_) sendGathered(Reach::Disk);
    const Call fresh = selectRow(table, row);
    Handle& handle = writer();
    // From here on the row is let go whatever happens.
    lock->taken();
    locked_.insert(key);
    try {
        // The second statement sees what was stored until the first one had the row.
        const Result found = handle.run({{Take, {key}}, fresh});
        append(found.get(), row, into);
    } catch (const core::Failure& failure) {
        if (failure.code() != LockNotAvailable) throw;
        lock.reset();
        refuseRow(table, row, holderOf(key));
    }
    return lock;
}

QString Session::holderOf(const QByteArray& key) {
    const Result found = writer().run(Holder, {key});
    const bool isKnown = PQntuples(found.get()) > 0 && PQgetlength(found.get(), 0, 0) > 0;
    return isKnown ? QString::fromUtf8(PQgetvalue(found.get(), 0, 0)) : OtherWorkstation;
}

void Session::unlock(const QByteArray& key) noexcept {
    broken_.remove(key);
    try {
        if (locked_.remove(key) && writer_ && !writer_->isLost()) writer_->send({LetGo, {key}});
    } catch (const std::exception&) {
        // Without the connection the server has let go already.
    }
}

bool Session::isHeld(const QByteArray& key) const {
    return locked_.contains(key) && writer_ && !writer_->isLost();
}

Handle& Session::writerOf(const QString& table, RowIdentity row) {
    if (isGathering_) sendGathered(Reach::Disk);
    Handle& handle = writer();
    if (broken_.contains(keyOf(table, row)))
        throw core::Failure(core::RowInUse,
                            u"A ligação a «%1» perdeu-se enquanto a linha era gravada; nada foi "
                            u"gravado. Tente de novo."_s.arg(book_));
    return handle;
}

}  // namespace ado::postgres
