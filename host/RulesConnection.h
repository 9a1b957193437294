// SPDX-License-Identifier: MIT
#pragma once

#include "boundary/environment/dtZelmars.h"
#include "host/BookSettings.h"

namespace host {

/// Opens a connection for the rules of this program, whose data environment is not that of the
/// component, and closes it at its end.
class RulesConnection {
public:
    explicit RulesConnection(const BookSettings& settings)
        : connection_(environment::dtZelmars::instance().MSAccess()) {
        connection_->ConnectionString = settings.connectionString();
        connection_->Open();
    }
    ~RulesConnection() { connection_->Close(); }
    RulesConnection(const RulesConnection&) = delete;
    RulesConnection& operator=(const RulesConnection&) = delete;

    bool mayWrite(const QString& table) const { return connection_->mayWrite(table); }

private:
    ado::ConnectionPtr connection_;
};

}  // namespace host
