// SPDX-License-Identifier: MIT
#pragma once

#include <sqlite3.h>

#include <QByteArray>
#include <QElapsedTimer>
#include <QHash>
#include <QString>
#include <memory>
#include <optional>
#include <unordered_map>

#include "platform/ado/engine/Session.h"
#include "platform/core/Wait.h"

namespace ado::sqlite {

/// A prepared statement; finalised when destroyed.
struct SqliteFinalize {
    void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
};
using SqliteStatement = std::unique_ptr<sqlite3_stmt, SqliteFinalize>;

/// A query that stays prepared, with what was asked about its columns. `key` is empty for one that
/// is not worth keeping.
struct SqliteQuery {
    QString key;
    SqliteStatement statement;
    std::vector<Column> described;
};

/// One open handle on a book, with the collation of this system and its settings. Failures carry
/// the engine's text and its extended result code.
class Handle {
public:
    enum class Role { Reader, Writer };

    /// Opens an existing file; never makes one.
    Handle(const QString& path, Role role, int timeoutSeconds);
    ~Handle();
    Handle(const Handle&) = delete;
    Handle& operator=(const Handle&) = delete;

    sqlite3* get() const { return db_; }
    void setTimeout(int seconds);
    /// For work that takes as long as it takes; others that write are still waited for.
    void liftLimits();

    /// Prepares the text, all of it: a second statement in it is refused.
    SqliteStatement prepare(const QByteArray& text);
    /// A query kept by keep() under that text; null when there is none, or it is in use.
    std::unique_ptr<SqliteQuery> take(const QString& key);
    void keep(std::unique_ptr<SqliteQuery> query);
    /// A statement of this layer's own, prepared once and reset; valid until the next call.
    sqlite3_stmt* cached(const QByteArray& text);
    void execute(const char* text);
    /// Runs a cached statement that gives no row.
    void run(sqlite3_stmt* statement);
    /// Steps a statement; the engine has the time-out for each step.
    int step(sqlite3_stmt* statement);
    [[noreturn]] void fail();

private:
    /// As long as the engine is asked for something.
    class Asking {
    public:
        explicit Asking(Handle& handle);
        ~Asking();
        Asking(const Asking&) = delete;
        Asking& operator=(const Asking&) = delete;

    private:
        Handle& handle_;
    };
    void limitWork();
    bool goesOn(const QString& what);
    int prepare(const QByteArray& text, unsigned flags, sqlite3_stmt** statement,
                const char** tail);
    static int endLate(void* handle);
    static int awaitOthers(void* handle, int tries);
    static int committed(void* handle, sqlite3* db, const char* schema, int frames);

    sqlite3* db_ = nullptr;
    int timeout_ = -1;
    int nextCheckpoint_ = 0;  ///< frames of the journal at which it is written back into the book
    QElapsedTimer waited_;
    bool isWorking_ = false;  ///< for longer than a moment, since works_ was started
    QElapsedTimer works_;
    std::optional<core::Wait> waiting_;
    bool isGivenUp_ = false;  ///< by the operator, what the engine was asked for last
    QHash<QByteArray, std::shared_ptr<sqlite3_stmt>> cache_;
    /// Of a query that is open twice at a time there are two.
    std::unordered_multimap<QString, std::unique_ptr<SqliteQuery>> queries_;
};

}  // namespace ado::sqlite
