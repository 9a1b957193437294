// SPDX-License-Identifier: MIT
#pragma once

#include <exception>

#include "platform/ado/Connection.h"
#include "platform/ado/engine/Session.h"

namespace ado {

/// Bulk work of very many rows does not wait for the disk at each one: while this lives, the writes
/// through a connection are gathered. After a failure, a kill or a power cut what stands is a
/// beginning of them in the order in which they were made; a row that fails leaves those before it
/// standing. Of a row that was added its key cannot be read.
class GatheredWrites {
public:
    explicit GatheredWrites(const ConnectionPtr& connection) : session_(connection->session()) {
        session_->gather();
    }
    /// Stores what was written before a failure.
    ~GatheredWrites() {
        if (!session_) return;
        try {
            session_->settle();
        } catch (const std::exception&) {
            // Intentional: the failure that ended the work is the one that is told.
        }
    }
    GatheredWrites(const GatheredWrites&) = delete;
    GatheredWrites& operator=(const GatheredWrites&) = delete;

    /// The end: everything is on the disk. Fails with what a write failed with.
    void store() { std::exchange(session_, nullptr)->settle(); }

private:
    std::shared_ptr<Session> session_;
};

}  // namespace ado
