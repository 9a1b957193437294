// SPDX-License-Identifier: MIT
#include "platform/ado/Rows.h"

#include <limits>

namespace ado {

namespace {

/// Rows that are taken in at once; a set with no more of them holds on to nothing.
constexpr qint64 FewRows = 32;
/// Bytes that the rows of a dear query may take when they are counted.
constexpr std::size_t MostCounted = 64 << 20;

}  // namespace

Rows::Rows(std::shared_ptr<Pass> pass, bool all, bool isDear)
    : pass_(std::move(pass)), store_(std::make_shared<RowStore>()), isDear_(isDear) {
    take(all ? std::numeric_limits<qint64>::max() : FewRows);
}

Rows::Rows(std::shared_ptr<Pass> description, std::shared_ptr<RowStore> store)
    : pass_(std::move(description)), store_(std::move(store)), complete_(true) {
    count_ = store_->count();
}

void Rows::take(qint64 most) {
    while (store_->count() < most) {
        if (!pass_->step()) {
            count_ = store_->count();
            complete_ = true;
            pass_->release();
            return;
        }
        store_->append(*pass_);
        ++passRow_;
    }
}

void Rows::takeAll() {
    if (complete_) return;
    if (kept(0)) seek(store_->count() - 1);
    take(std::numeric_limits<qint64>::max());
}

bool Rows::seek(qint64 row) {
    if (row < passRow_) {
        pass_->restart();
        passRow_ = -1;
    }
    while (passRow_ < row) {
        ++passRow_;
        if (!pass_->step()) {
            count_ = passRow_;
            return false;
        }
    }
    return true;
}

bool Rows::toFirst() {
    row_ = 0;
    return kept(0);
}

bool Rows::toNext() {
    ++row_;
    if (kept(row_)) return true;
    if (count_ >= 0 && row_ >= count_) return false;
    return seek(row_);
}

void Rows::countAll() {
    if (count_ >= 0) return;
    const qint64 first = store_->count();
    if (isDear_ && passRow_ == first - 1) {
        store_->reserve(MostCounted);
        while (store_->bytes() < MostCounted) {
            if (!pass_->step()) {
                count_ = store_->count();
                complete_ = true;
                pass_->release();
                return;
            }
            store_->append(*pass_);
            ++passRow_;
        }
        store_->shrinkTo(first);
    }
    count_ = pass_->rowsInAll();
    passRow_ = count_;
}

// The last row becomes the current one without being read: whoever only wants the count goes back
// to the first.
bool Rows::toLast() {
    countAll();
    row_ = count_ - 1;
    return count_ > 0;
}

RowIdentity Rows::identity() {
    if (kept(row_)) return store_->identity(row_);
    if (passRow_ != row_) seek(row_);
    return pass_->identity();
}

}  // namespace ado
