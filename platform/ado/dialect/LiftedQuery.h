// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <vector>

#include "platform/ado/dialect/Query.h"
#include "platform/ado/engine/Cell.h"

namespace ado {

/// A query whose values are taken out of its conditions: queries that differ in nothing else
/// have one text, which an engine prepares once.
struct LiftedQuery {
    QString text;              ///< with a "?" in the place of each value
    std::vector<Cell> values;  ///< texts point into `texts`
    std::vector<QByteArray> texts;

    /// Nothing when there is something in the query that only the whole text can tell, such as
    /// dates and joined texts.
    static std::optional<LiftedQuery> from(const Query& query);
};

}  // namespace ado
