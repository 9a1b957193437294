// SPDX-License-Identifier: MIT
#include "platform/ado/SqliteHandle.h"

#include <QThread>

#include "platform/ado/SqliteCollation.h"
#include "platform/ado/SqliteFile.h"
#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

/// Statements that stay prepared; more than these and all are prepared anew.
constexpr std::size_t CachedStatements = 64;
/// Bytes to which the journal shrinks again after a long scan made it grow.
constexpr auto JournalLimit = "PRAGMA journal_size_limit=16777216";

/// Frames of the journal after which it is written back into the book.
constexpr int CheckpointFrames = 1000;

/// Steps of the engine between two looks at the clock; a millisecond or so.
constexpr int StepsUnwatched = 50'000;

/// An enlarged bind that is blank or a comment holds no second statement.
bool isBlank(const char* text) {
    while (*text == ' ' || *text == '\n' || *text == '\t' || *text == '\r' || *text == ';') ++text;
    return *text == '\0';
}

}  // namespace

SqliteHandle::SqliteHandle(const QString& path, Role role, int timeoutSeconds) {
    const int flags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX | SQLITE_OPEN_EXRESCODE;
    try {
        if (sqlite3_open_v2(path.toUtf8().constData(), &db_, flags, nullptr) != SQLITE_OK) fail();
        setTimeout(timeoutSeconds);
        installCollation(db_);
        execute(role == Role::Reader ? "PRAGMA query_only=1" : "PRAGMA synchronous=FULL");
        if (role == Role::Writer) {
            execute(JournalLimit);
            sqlite3_wal_hook(db_, committed, this);
        }
    } catch (...) {
        sqlite3_close_v2(db_);
        throw;
    }
}

SqliteHandle::~SqliteHandle() {
    cache_.clear();
    queries_.clear();
    // Row sets may still hold their statements; the last of them closes for good.
    sqlite3_close_v2(db_);
}

void SqliteHandle::setTimeout(int seconds) {
    if (seconds == timeout_) return;
    timeout_ = seconds;
    sqlite3_busy_handler(db_, awaitOthers, this);
    sqlite3_progress_handler(db_, StepsUnwatched, endLate, this);
}

/// Ends work that takes longer than the time-out, which is a second at the least.
int SqliteHandle::endLate(void* handle) {
    auto* const self = static_cast<SqliteHandle*>(handle);
    if (!self->isWorking_) self->works_.start();
    self->isWorking_ = true;
    return self->works_.elapsed() >= qint64{qMax(1, self->timeout_)} * 1000;
}

/// Waits while another program writes; 0 when the time is over. The engine's own waiting lengthens
/// its pauses to 100 ms: where several write without end, some are then kept out for seconds.
int SqliteHandle::awaitOthers(void* handle, int tries) {
    auto* const self = static_cast<SqliteHandle*>(handle);
    if (tries == 0) self->waited_.start();
    if (self->waited_.elapsed() >= qint64{self->timeout_} * 1000) return 0;
    QThread::msleep(tries == 0 ? 1 : 2);
    return 1;
}

SqliteStatement SqliteHandle::prepare(const QByteArray& text) {
    sqlite3_stmt* statement = nullptr;
    const char* tail = nullptr;
    if (sqlite3_prepare_v2(db_, text.constData(), static_cast<int>(text.size()) + 1, &statement,
                           &tail) != SQLITE_OK)
        fail();
    SqliteStatement owned(statement);
    if (!isBlank(tail) || (statement && !sqlite3_stmt_readonly(statement)))
        throw core::Failure(core::InvalidCall, u"Só é aceite uma consulta de cada vez."_s);
    return owned;
}

std::unique_ptr<SqliteQuery> SqliteHandle::take(const QString& key) {
    const auto found = queries_.find(key);
    if (found == queries_.end()) return nullptr;
    std::unique_ptr<SqliteQuery> query = std::move(found->second);
    queries_.erase(found);
    return query;
}

void SqliteHandle::keep(std::unique_ptr<SqliteQuery> query) {
    if (query->key.isEmpty()) return;
    sqlite3_reset(query->statement.get());
    sqlite3_clear_bindings(query->statement.get());
    if (queries_.size() >= CachedStatements) queries_.clear();
    QString key = query->key;
    queries_.insert_or_assign(std::move(key), std::move(query));
}

sqlite3_stmt* SqliteHandle::cached(const QByteArray& text) {
    auto found = cache_.constFind(text);
    if (found == cache_.constEnd()) {
        if (static_cast<std::size_t>(cache_.size()) >= CachedStatements) cache_.clear();
        sqlite3_stmt* statement = nullptr;
        if (sqlite3_prepare_v3(db_, text.constData(), static_cast<int>(text.size()) + 1,
                               SQLITE_PREPARE_PERSISTENT, &statement, nullptr) != SQLITE_OK)
            fail();
        found = cache_.insert(text, std::shared_ptr<sqlite3_stmt>(statement, sqlite3_finalize));
    }
    sqlite3_reset(found->get());
    beginWork();
    return found->get();
}

// A long pass keeps the journal from being written back, and every attempt goes through all of it
// in vain: each one waits until the journal has grown by half since the last.
int SqliteHandle::committed(void* handle, sqlite3* db, const char* schema, int frames) {
    int& next = static_cast<SqliteHandle*>(handle)->nextCheckpoint_;
    if (frames < CheckpointFrames) next = CheckpointFrames;
    if (frames < next) return SQLITE_OK;
    int inJournal = 0;
    int writtenBack = 0;
    sqlite3_wal_checkpoint_v2(db, schema, SQLITE_CHECKPOINT_PASSIVE, &inJournal, &writtenBack);
    next = writtenBack == inJournal ? CheckpointFrames : frames + frames / 2;
    return SQLITE_OK;
}

void SqliteHandle::execute(const char* text) {
    if (sqlite3_exec(db_, text, nullptr, nullptr, nullptr) != SQLITE_OK) fail();
}

void SqliteHandle::run(sqlite3_stmt* statement) {
    const int result = sqlite3_step(statement);
    if (result == SQLITE_DONE || result == SQLITE_ROW) {
        sqlite3_reset(statement);
        return;
    }
    try {
        fail();
    } catch (...) {
        sqlite3_reset(statement);
        throw;
    }
}

void SqliteHandle::fail() {
    const int code = sqlite3_extended_errcode(db_);
    const QString text =
        code == SQLITE_INTERRUPT
            ? u"A base de dados não acabou em %1 segundos; o pedido foi interrompido."_s.arg(
                  qMax(1, timeout_))
        : (code & 0xFF) == SQLITE_READONLY
            ? noRightText(QString::fromUtf8(sqlite3_db_filename(db_, "main")))
            : QString::fromUtf8(sqlite3_errmsg(db_));
    throw core::Failure(core::DatabaseFailure, text, QString::number(code));
}

}  // namespace ado
