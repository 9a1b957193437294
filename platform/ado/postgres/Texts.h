// SPDX-License-Identifier: MIT
#pragma once

#include <QHash>
#include <optional>

#include "platform/ado/dialect/LiftedQuery.h"
#include "platform/ado/postgres/Dialect.h"
#include "platform/ado/postgres/Handle.h"

namespace ado::postgres {

/// Statements in the server's dialect. Those that the daily work sends again and again differ only
/// in the values of their conditions; their texts are made once, with parameters for the values, so
/// that the server plans them once as well.
class Texts {
public:
    explicit Texts(Schema& schema) : schema_(schema) {}

    /// The statement as it stands.
    QByteArray whole(const Query& statement, bool withIdentity);
    /// Its text with parameters and their values; nothing where only the whole text will do.
    std::optional<Call> lifted(const Query& statement, bool withIdentity);
    /// Notes that the server does not take the statement in parts.
    void keepWhole(const Query& statement, bool withIdentity);

private:
    Schema& schema_;
    QHash<QString, QByteArray> texts_;  ///< by key; an empty one is to be taken whole
};

}  // namespace ado::postgres
