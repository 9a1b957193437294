// SPDX-License-Identifier: MIT
#pragma once

#include <libpq-fe.h>

#include <QByteArray>
#include <QDeadlineTimer>
#include <QHash>
#include <QSet>
#include <QString>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

#include "platform/ado/postgres/Address.h"

namespace core {
class Wait;
}

namespace ado::postgres {

struct ClearResult {
    void operator()(PGresult* result) const { PQclear(result); }
};
using Result = std::unique_ptr<PGresult, ClearResult>;
/// Parameters as text; nothing for null.
using Values = std::vector<std::optional<QByteArray>>;

/// A statement with the values of its parameters.
struct Call {
    QByteArray text;
    Values values;
};

/// One connection to a server. No call waits longer than its time-out, also when the server stops
/// answering. Failures carry the server's text and its SQLSTATE.
///
/// The client library's pipeline is always on: statements are sent one behind the other and make
/// one transaction up to the next synchronisation.
class Handle {
public:
    enum class Role { Reader, Writer };

    Handle(const Address& address, Role role);
    ~Handle();
    Handle(const Handle&) = delete;
    Handle& operator=(const Handle&) = delete;

    /// The server's numbers of all connections that this process has or had.
    static QSet<int> ownBackends();
    /// A bare connection, for work of another kind than a workstation's; the caller's own.
    static PGconn* connected(const Address& address);

    /// Seconds that a statement may run or wait for a lock.
    void setTimeout(int seconds);
    /// True when the connection is of no use any more.
    bool isLost();

    /// Runs statements in one round trip and commits them; gives the answer of the last one. They
    /// stay prepared.
    Result run(const std::vector<Call>& calls);
    Result run(const QByteArray& text, const Values& values = {}) {
        return run(std::vector<Call>{{text, values}});
    }
    /// Runs one statement and, once it is answered, commits it: a server that wakes up late finds
    /// nobody to commit, so that a row added again after a failure stands once. Where only the
    /// answer to the commit is lost, the failure's text says so.
    /// @param more  what goes into the same commit, told by the answer; may be nothing
    using More = std::function<std::optional<Call>(const PGresult* answer)>;
    Result runThenCommit(const Call& call, const More& more);
    /// Runs one statement that will hardly come again, and commits it.
    Result runOnce(const QByteArray& text);
    /// Sends a statement and commits it, without waiting for the answer, which nobody sees.
    void send(const Call& call);
    void send(const QByteArray& text);

    /// Sends statements of an open transaction; answer() waits for the last one's answer. One that
    /// nobody waited for is dropped. After a failure nothing of the transaction is left.
    void ask(const std::vector<QByteArray>& texts);
    Result answer();
    /// Ends the open transaction, without waiting.
    void finish();

private:
    Handle() = default;
    void connect(const Address& address);
    void start(const Address& address, const Address::Found& found);
    bool wantsBarePassword() const;
    void settle(Role role);
    /// Both give the number of answers that will come.
    int dispatch(const QByteArray& text);
    int dispatch(const Call& call);
    void forget(const QByteArray& text);
    void flush();
    void synchronise();
    Result drain(int but);
    PGresult* take();
    void wait(core::Wait& waiting);
    int patience() const;
    void requireConnection();
    Result answers(int count);
    Result committed(int count);
    [[noreturn]] void refuse(const PGresult* result);
    [[noreturn]] void lose(const QString& text, const QString& code = QStringLiteral("08006"));

    PGconn* connection_ = nullptr;
    QString place_;
    QString awaited_;  ///< what the operator reads while an answer is waited for
    bool lost_ = false;
    int timeout_ = -1;
    int unread_ = 0;  ///< synchronisations whose answers nobody has read
    int asked_ = 0;   ///< statements that answer() waits for
    QDeadlineTimer deadline_;
    QHash<QByteArray, QByteArray> prepared_;  ///< names by text
    int lastPrepared_ = 0;
};

}  // namespace ado::postgres
