// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <vector>

#include "platform/ado/engine/Session.h"

namespace ado {

class RowFile;

/// Rows in memory, packed: a byte for a null, nine for a number, a text's bytes and five more. A
/// value is unpacked when it is asked for. Very many rows can be set aside in a file.
class RowStore {
public:
    qint64 count() const { return static_cast<qint64>(starts_.size()); }
    void clear();
    /// Room for so many bytes without moving what is there; it is taken as it is used.
    void reserve(std::size_t bytes) { bytes_.reserve(bytes); }
    /// Bytes of all rows and of what is known of each.
    std::size_t bytes() const {
        return bytes_.size() + starts_.size() * (sizeof starts_[0] + sizeof identities_[0]);
    }
    /// Drops the rows behind the first so many, and their room.
    void shrinkTo(qint64 count);
    /// True when both keep the same rows with the same values.
    bool operator==(const RowStore&) const = default;

    /// Appends the row that the pass stands on.
    void append(const Pass& pass);
    // The same by steps: one beginRow, then the cells of all columns in their order.
    void beginRow(RowIdentity identity);
    void add(const Cell& cell);

    /// Moves the packed rows to a file, from which they are read when they are asked for. Such a
    /// store can grow, but not shrink.
    void setAside(const std::shared_ptr<RowFile>& file);
    /// Bytes of the packed rows that are not set aside.
    std::size_t packedBytes() const { return bytes_.size(); }

    /// Null for a column that the row does not have: the table was altered since. The text of a row
    /// that was set aside is good until another row is asked for.
    Cell cell(qint64 row, int column) const;
    RowIdentity identity(qint64 row) const { return identities_[static_cast<std::size_t>(row)]; }

private:
    struct Aside;

    const char* packed(std::size_t start, std::size_t end) const;

    std::vector<char> bytes_;
    std::vector<std::size_t> starts_;  ///< as if nothing were set aside
    std::vector<RowIdentity> identities_;
    std::size_t before_ = 0;        ///< bytes that were set aside
    std::shared_ptr<Aside> aside_;  ///< none while nothing was
};

}  // namespace ado
