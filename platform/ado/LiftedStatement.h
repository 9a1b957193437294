// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <vector>

#include "platform/ado/Cell.h"
#include "platform/ado/Statement.h"

namespace ado {

/// A statement whose values are taken out of its conditions: statements that differ in nothing else
/// have one text, which an engine prepares once.
struct LiftedStatement {
    QString text;              ///< with a "?" in the place of each value
    std::vector<Cell> values;  ///< texts point into `texts`
    std::vector<QByteArray> texts;

    /// Nothing when there is something in the statement that only the whole text can tell, such as
    /// dates and joined texts.
    static std::optional<LiftedStatement> from(const Statement& statement);
};

}  // namespace ado
