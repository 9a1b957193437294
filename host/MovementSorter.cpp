// SPDX-License-Identifier: MIT
#include "host/MovementSorter.h"

#include "host/LeftForLater.h"

namespace host {

void MovementSorter::start(const Wish& wish) {
    if (!isBusy_) return run(wish);
    isForgotten_ = true;
    next_ = wish;
}

void MovementSorter::forget() {
    isForgotten_ = true;
    next_.reset();
}

void MovementSorter::run(const Wish& wish) {
    isBusy_ = true;
    isForgotten_ = false;
    thread_ = std::jthread([this, wish] {
        std::vector<quint32> positions = MovementOrder(*wish.search).by(wish.column, wish.order);
        QMetaObject::invokeMethod(this,
                                  [this, positions = std::move(positions)] { take(positions); });
    });
}

void MovementSorter::take(const std::vector<quint32>& positions) {
    // Those who are told read the book.
    if (leftForLater(this, [this, positions] { take(positions); })) return;
    if (next_) return run(*std::exchange(next_, std::nullopt));
    isBusy_ = false;
    emit finished(isForgotten_ ? std::vector<quint32>() : positions);
}

}  // namespace host
