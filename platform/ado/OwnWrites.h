// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>
#include <algorithm>
#include <map>
#include <unordered_map>
#include <vector>

#include "platform/ado/engine/Column.h"

namespace ado {

/// What a row set wrote to its table since its query ran. The query's rows are numbered from 0 and
/// stay as they were read; this tells which of them are others by now. The rows that the set
/// inserted have numbers from 0 of their own, and a list shows them behind the query's.
class OwnWrites {
public:
    /// @param values  what was stored there, by column
    /// @param inMemory  rows in memory are few, and what was stored there is kept; of the rows of a
    /// long pass a mark each is all that it may cost, and such a row is read afresh
    void noteStored(qint64 row, const std::map<int, QVariant>& values, bool inMemory) {
        const auto place = static_cast<std::size_t>(row);
        if (!inMemory && place >= marked_.size()) marked_.resize(place + 1);
        if (!inMemory)
            marked_[place] = true;
        else
            for (const auto& [column, value] : values) stored_[row][column] = value;
    }
    void noteDeleted(qint64 row) {
        deleted_.insert(std::upper_bound(deleted_.begin(), deleted_.end(), row), row);
    }
    void noteInserted(RowIdentity identity) { inserted_.push_back(identity); }
    void noteInsertedDeleted(qint64 which) { inserted_.erase(inserted_.begin() + which); }

    /// The value that was stored there and kept; null for none.
    const QVariant* stored(qint64 row, int column) const {
        const auto values = stored_.find(row);
        if (values == stored_.end()) return nullptr;
        const auto value = values->second.find(column);
        return value != values->second.end() ? &value->second : nullptr;
    }
    /// True for a row that was stored without its values being kept.
    bool isMarked(qint64 row) const {
        const auto place = static_cast<std::size_t>(row);
        return place < marked_.size() && marked_[place];
    }
    bool isDeleted(qint64 row) const {
        return std::binary_search(deleted_.begin(), deleted_.end(), row);
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
    std::unordered_map<qint64, std::map<int, QVariant>> stored_;
    std::vector<bool> marked_;
    std::vector<qint64> deleted_;  ///< ascending
    std::vector<RowIdentity> inserted_;
};

}  // namespace ado
