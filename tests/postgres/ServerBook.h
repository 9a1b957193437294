// SPDX-License-Identifier: MIT
#pragma once

#include <gtest/gtest.h>

#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"
#include "tests/support/Server.h"

struct pg_conn;

/// A book with a few small tables on the test run's server, and a connection to it. What `exec`
/// runs is what any other program does.
class ServerBook : public testing::Test {
protected:
    ServerBook();
    ~ServerBook() override;

    static QString connectionString(const QString& catalog, const QString& user,
                                    const QString& provider = QStringLiteral("SQLOLEDB.1"));
    ado::ConnectionPtr connect(int timeoutSeconds = 5,
                               const QString& provider = QStringLiteral("SQLOLEDB.1")) const;
    /// The defaults are those of an editing screen.
    static ado::RecordsetPtr open(const QString& statement, const ado::ConnectionPtr& connection,
                                  ado::LockType lock = ado::adLockPessimistic,
                                  ado::CursorType cursor = ado::adOpenStatic);
    /// Runs statements; a failure fails the test. Gives the first value of the last one as text,
    /// "NULL" for null and "-" for no row.
    QString exec(const QString& statements);
    /// Rows 1 to `count` of tbMov.
    void fill(int count);

    QString catalog;
    pg_conn* other = nullptr;
    ado::ConnectionPtr connection;
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
