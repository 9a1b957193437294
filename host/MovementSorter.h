// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <memory>
#include <optional>
#include <thread>

#include "host/MovementOrder.h"

namespace host {

/// Sorts movements beside the window, which stays usable meanwhile.
class MovementSorter : public QObject {
    Q_OBJECT
public:
    /// What to sort; it must not be changed before finished() comes.
    struct Wish {
        std::shared_ptr<const MovementSearch> search;
        MovementRow::Column column;
        Qt::SortOrder order;
    };

    using QObject::QObject;
    /// Sorts as wished. What is under way is finished first, and its result dropped.
    void start(const Wish& wish);
    /// Drops the result of what is under way: finished() comes without positions.
    void forget();
    /// True while another thread reads what is sorted.
    bool isBusy() const { return isBusy_; }

signals:
    /// The positions of all movements as wished; empty when they were forgotten.
    void finished(const std::vector<quint32>& positions);

private:
    void run(const Wish& wish);
    void take(const std::vector<quint32>& positions);

    bool isBusy_ = false;
    bool isForgotten_ = false;
    std::optional<Wish> next_;
    std::jthread thread_;
};

}  // namespace host
