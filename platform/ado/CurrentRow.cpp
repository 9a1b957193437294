// SPDX-License-Identifier: MIT
#include "platform/ado/CurrentRow.h"

#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

void CurrentRow::leave() {
    isNew_ = isDeleted_ = isOutdated_ = false;
    changes_.clear();
    forgetFresh();
    lock_.reset();
    hold_ = Hold::None;
}

void CurrentRow::forgetFresh() {
    if (isFresh()) fresh_.clear();
    written_.clear();
}

void CurrentRow::standOn(At at, bool isOutdated, qint64 inserted) {
    leave();
    at_ = at;
    inserted_ = inserted;
    isOutdated_ = isOutdated;
}

void CurrentRow::startNew() {
    const bool wasDeleted = isDeleted_;
    leave();
    isDeleted_ = wasDeleted;
    isNew_ = true;
}

void CurrentRow::noteDeleted() {
    leave();
    isDeleted_ = true;
    if (at_ == At::Inserted) --inserted_;  // the next move comes to the row behind
}

void CurrentRow::cancel(bool isOutdated) {
    changes_.clear();
    if (isHoldBroken()) {  // the row is held and read anew when it is looked at
        lock_.reset();
        hold_ = Hold::None;
    }
    if (isNew_) isOutdated_ = isOutdated;
    isNew_ = false;
}

void CurrentRow::noteStored(bool isOutdated) {
    isOutdated_ = isOutdated || isOutdated_ || isFresh();
    forgetFresh();
    changes_.clear();
}

void CurrentRow::letGo() {
    lock_.reset();
    hold_ = Hold::LetGo;
}

void CurrentRow::look(const TableRow& row, bool pessimistic) {
    if (!pessimistic || hold_ != Hold::None) {
        read(row);
        return;
    }
    forgetFresh();
    lock_ = row.session->lock(row.table, row.identity, row.timeoutSeconds, fresh_);
    hold_ = Hold::Taken;
    isOutdated_ = false;
}

bool CurrentRow::read(const TableRow& row) {
    isOutdated_ = false;
    forgetFresh();
    return row.session->read(row.table, row.identity, fresh_);
}

void CurrentRow::holdAgain(const TableRow& row) {
    lock_.reset();
    RowStore now;
    std::unique_ptr<RowLock> again =
        row.session->lock(row.table, row.identity, row.timeoutSeconds, now);
    if (now != fresh_)
        throw core::Failure(
            core::RowInUse,
            u"A ligação a «%1» perdeu-se e a linha foi entretanto alterada por "
            u"outro posto; nada foi gravado. Leia-a de novo."_s.arg(row.session->book()));
    lock_ = std::move(again);
}

}  // namespace ado
