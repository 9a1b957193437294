// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/engine/Session.h"

namespace ado::sqlite {

/// Rows held against every other row set, in this process and in every other one on this machine:
/// byte-range locks on the file beside the book, one byte for a row, let go by the system when a
/// process ends. The same file keeps who took them, for the text of a refusal.
class Locks {
public:
    /// @param book  path of the book's file
    explicit Locks(const QString& book) : book_(book) {}

    /// Waits at most `timeoutSeconds`, and not at all for a row set of the same thread, which could
    /// not let go meanwhile. Fails with RowInUse and a text that names the holder.
    std::unique_ptr<RowLock> lock(const QString& table, RowIdentity row, int timeoutSeconds) const;

private:
    QString book_;
};

}  // namespace ado::sqlite
