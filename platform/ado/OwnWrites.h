// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>
#include <algorithm>
#include <unordered_map>
#include <utility>
#include <vector>

#include "platform/ado/engine/Column.h"

namespace ado {

/// Values of a row by column, few of them.
using Changes = std::vector<std::pair<int, QVariant>>;

/// The value of a column among them; null for none.
inline const QVariant* find(const Changes& changes, int column) {
    for (const auto& [each, value] : changes)
        if (each == column) return &value;
    return nullptr;
}

/// Puts a value in the place of the column's former one, or behind the others.
inline void put(Changes& changes, int column, const QVariant& value) {
    for (auto& [each, known] : changes)
        if (each == column) {
            known = value;
            return;
        }
    changes.emplace_back(column, value);
}

/// What a row set wrote to its table since its query ran. The query's rows are numbered from 0 and
/// stay as they were read; this tells which of them are others by now. The rows that the set
/// inserted have numbers from 0 of their own, and a list shows them behind the query's.
class OwnWrites {
public:
    /// @param values  what was stored there, by column
    /// @param inMemory  rows in memory are few, and what was stored there is kept; of the rows of a
    /// long pass a mark each is all that it may cost, and such a row is read afresh
    void noteStored(qint64 row, const Changes& values, bool inMemory) {
        const auto place = static_cast<std::size_t>(row);
        if (!inMemory && place >= marked_.size()) marked_.resize(place + 1);
        if (!inMemory)
            marked_[place] = true;
        else
            for (const auto& [column, value] : values) put(stored_[row], column, value);
    }
    void noteDeleted(qint64 row) {
        // Mostly a table is gone through from its first row to the last.
        if (deleted_.empty() || row > deleted_.back()) return deleted_.push_back(row);
        deleted_.insert(std::upper_bound(deleted_.begin(), deleted_.end(), row), row);
    }
    void noteInserted(RowIdentity identity) { inserted_.push_back(identity); }
    void noteInsertedDeleted(qint64 which) { inserted_.erase(inserted_.begin() + which); }

    /// The value that was stored there and kept; null for none.
    const QVariant* stored(qint64 row, int column) const {
        const auto values = stored_.find(row);
        return values == stored_.end() ? nullptr : find(values->second, column);
    }
    /// True for a row that was stored without its values being kept.
    bool isMarked(qint64 row) const {
        const auto place = static_cast<std::size_t>(row);
        return place < marked_.size() && marked_[place];
    }
    bool isDeleted(qint64 row) const {
        return !deleted_.empty() && row <= deleted_.back() &&
               std::binary_search(deleted_.begin(), deleted_.end(), row);
    }
    qint64 insertedCount() const { return static_cast<qint64>(inserted_.size()); }
    RowIdentity inserted(qint64 which) const { return inserted_[static_cast<std::size_t>(which)]; }

    /// How many rows a list shows of a query that found so many.
    qint64 shownOf(qint64 found) const {
        return found - static_cast<qint64>(deleted_.size()) + insertedCount();
    }
    /// The query's row that a list shows at that place. From the number of the query's rows on it
    /// is an inserted one.
    qint64 shownAt(qint64 place) const {
        for (const qint64 row : deleted_) place += row <= place ? 1 : 0;
        return place;
    }

private:
    std::unordered_map<qint64, Changes> stored_;
    std::vector<bool> marked_;
    std::vector<qint64> deleted_;  ///< ascending
    std::vector<RowIdentity> inserted_;
};

}  // namespace ado
