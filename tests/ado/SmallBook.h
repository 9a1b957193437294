// SPDX-License-Identifier: MIT
#pragma once

#include <sqlite3.h>

#include <QTemporaryDir>

#include "platform/ado/Recordset.h"
#include "platform/core/Failure.h"

/// A book with a few small tables in a temporary folder, and a second handle on it that stands for
/// any other program.
class SmallBook {
public:
    SmallBook();
    ~SmallBook();

    QString folder() const { return folder_.path(); }
    QString file() const { return folder_.filePath(QStringLiteral("livro.db")); }
    /// @param provider  "MSDataShape.1" for a connection that shapes
    ado::ConnectionPtr connect(const QString& provider = QStringLiteral("SQLOLEDB.1"),
                               int timeoutSeconds = 5) const;

    // What another program does; a failure ends the test with the engine's text.
    void exec(const QString& statements);
    /// The first column of the first row as text; "NULL" for null, "-" for no row.
    QString value(const QString& statement);
    /// The same with the storage class before it, as in "real 87.35".
    QString stored(const QString& expression, const QString& table);
    sqlite3* handle() const { return other_; }

private:
    QTemporaryDir folder_;
    sqlite3* other_ = nullptr;
};

/// Opens a set; the defaults are those of an editing screen.
ado::RecordsetPtr openRows(const QString& statement, const ado::ConnectionPtr& connection,
                           ado::CursorType cursor = ado::adOpenStatic,
                           ado::LockType lock = ado::adLockPessimistic);

/// The text of the failure that the action ends with; empty when it does not fail.
template <class Action>
QString failureOf(Action&& action) {
    try {
        action();
    } catch (const core::Failure& failure) {
        return failure.text();
    }
    return {};
}

/// The number of the failure; 0 when there is none.
template <class Action>
int failureNumberOf(Action&& action) {
    try {
        action();
    } catch (const core::Failure& failure) {
        return failure.number();
    }
    return 0;
}
