// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/OwnWrites.h"
#include "platform/ado/engine/RowStore.h"

namespace ado {

/// Where a row set stands: on nothing, on a row of its query, or on one that the set inserted.
enum class At { Nothing, Queried, Inserted };

/// A row of a table and how it is reached.
struct TableRow {
    std::shared_ptr<Session> session;
    const QString& table;
    RowIdentity identity;
    int timeoutSeconds;
};

/// The row that is current in a row set: where it is, its values where they were read afresh from
/// the table, what was written to it and is not stored yet, and the lock that holds it.
class CurrentRow {
public:
    At at() const { return at_; }
    /// Which of the rows that the set inserted it is, from 0.
    qint64 inserted() const { return inserted_; }
    bool isNew() const { return isNew_; }
    /// False on nothing and on a row that the set deleted.
    bool exists() const { return isNew_ || (at_ != At::Nothing && !isDeleted_); }
    bool isNothing() const { return at_ == At::Nothing && !isNew_; }

    /// Drops everything that belongs to the row, its lock and a new row; the place stays.
    void leave();
    /// @param isOutdated  the values that the query read may not be the row's any more
    void standOn(At at, bool isOutdated, qint64 inserted = 0);
    /// A new row takes the place of the current one, which cancel() comes back to.
    void startNew();
    void noteDeleted();

    /// What was written and is not stored yet, by column.
    const Changes& changes() const { return changes_; }
    void change(int column, const QVariant& value) { put(changes_, column, value); }
    /// Drops the changes or the new row.
    /// @param isOutdated  as for standOn(), of the row that is come back to
    void cancel(bool isOutdated);
    /// The changes are stored; whoever looks at the row sees what stands in the table.
    void noteStored(bool isOutdated);
    /// The changes of a row that was read afresh are stored among gathered writes, during which
    /// nobody looks at the table: the row is as it was read and written here.
    void noteGathered() {
        for (const auto& [column, value] : changes_) put(written_, column, value);
        changes_.clear();
    }
    /// The value that was stored so; null for none.
    const QVariant* written(int column) const { return find(written_, column); }

    /// True when the values were read afresh.
    bool isFresh() const { return fresh_.count() > 0; }
    Cell cell(int column) const { return fresh_.cell(0, column); }

    // A row that is held is what it was read as. Update lets go of it for good: nobody holds it
    // again for a mere look, only for the next change.
    bool isHeld() const { return hold_ == Hold::Taken; }
    void letGo();
    void expectChange() {
        if (hold_ == Hold::LetGo) hold_ = Hold::None;
    }
    /// True when there is something to do for look().
    bool needsLook(bool pessimistic) const {
        return isOutdated_ || (pessimistic && hold_ == Hold::None);
    }
    /// Takes the lock that a row of a pessimistic set needs, or reads an outdated row afresh.
    void look(const TableRow& row, bool pessimistic);
    /// Reads the row afresh; false when it is gone.
    bool read(const TableRow& row);
    /// True when the connection that held the row was lost: somebody else may have it by now.
    bool isHoldBroken() const { return isHeld() && !(lock_ && lock_->isUnbroken()); }
    /// Takes a broken lock again; fails with RowInUse when the row is not any more as it was read.
    void holdAgain(const TableRow& row);

private:
    void forgetFresh();

    enum class Hold { None, Taken, LetGo };

    At at_ = At::Nothing;
    qint64 inserted_ = 0;
    bool isNew_ = false;
    bool isDeleted_ = false;  ///< the current row, by this set
    Changes changes_;
    RowStore fresh_;   ///< empty, or the row
    Changes written_;  ///< stored since the row was read afresh
    bool isOutdated_ = false;
    Hold hold_ = Hold::None;
    std::unique_ptr<RowLock> lock_;  ///< of Hold::Taken; none where it could not be taken again
};

}  // namespace ado
