// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include "platform/ado/Recordset.h"
#include "tests/support/Book.h"
#include "tests/support/Failure.h"

using support::failureOf;

/// A book with a few small tables more and a connection to it. What `book` runs by itself is what
/// any other program does.
class SmallBook : public testing::Test {
protected:
    SmallBook();

    ado::ConnectionPtr connect(int timeoutSeconds = 5) const;
    ado::ConnectionPtr connectShaping() const;
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
