// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"
#include "tests/support/Book.h"

/// A book with a few small tables and a connection to it. What `book` runs by itself is what any
/// other program does.
class SmallBook : public testing::Test {
protected:
    SmallBook();

    ado::ConnectionPtr connect(int timeoutSeconds = 5) const;
    /// The defaults are those of an editing screen.
    static ado::RecordsetPtr open(const QString& statement, const ado::ConnectionPtr& connection,
                                  ado::LockType lock = ado::adLockPessimistic,
                                  ado::CursorType cursor = ado::adOpenStatic);
    /// Rows 1 to `count` of tbMov.
    void fill(int count);

    support::Book book;
    ado::ConnectionPtr connection = connect();
};

/// The values of a column from the current row on, parted by commas.
QString valuesOf(const ado::RecordsetPtr& rows, const QString& column);

/// What the action fails with; number 0 and no text when it does not fail.
template <class Action>
core::Failure failureOf(Action&& action) {
    try {
        action();
    } catch (const core::Failure& failure) {
        return failure;
    }
    return {0, {}};
}
