// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Handle.h"

#include <QThread>
#include <limits>
#include <utility>

#include "platform/ado/sqlite/BookFile.h"
#include "platform/ado/sqlite/Collation.h"
#include "platform/ado/sqlite/Failures.h"
#include "platform/core/Failure.h"

namespace ado::sqlite {

using namespace Qt::StringLiterals;

namespace {

/// Statements that stay prepared; more than these and all are prepared anew.
constexpr std::size_t CachedStatements = 64;
/// Bytes to which the journal shrinks again after a long scan made it grow.
constexpr auto JournalLimit = "PRAGMA journal_size_limit=16777216";

/// Frames of the journal after which it is written back into the book.
constexpr int CheckpointFrames = 1000;

/// Steps of the engine between two looks at the clock. Each may be a function over a value of the
/// greatest length.
constexpr int StepsUnwatched = 100;
/// Bytes of a value or a row. What is longer no screen can have typed, and a function over it would
/// keep the engine busy past every time-out.
constexpr int LongestValue = 300'000;
constexpr int LongestPattern = 128;
/// Functions that over long values go on for minutes without a look at the clock, and the number of
/// their arguments. No statement of the system uses them.
constexpr std::pair<const char*, int> EndlessFunctions[] = {
    {"printf", -1}, {"format", -1}, {"instr", 2}, {"replace", 3},
    {"trim", 2},    {"ltrim", 2},   {"rtrim", 2}, {"json_patch", 2}};

/// What stands behind a statement and is blank is no second one.
bool isBlank(const char* text) {
    while (*text == ' ' || *text == '\n' || *text == '\t' || *text == '\r' || *text == ';') ++text;
    return *text == '\0';
}

}  // namespace

Handle::Handle(const QString& path, Role role, int timeoutSeconds) {
    const int flags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX | SQLITE_OPEN_EXRESCODE;
    try {
        if (sqlite3_open_v2(path.toUtf8().constData(), &db_, flags, nullptr) != SQLITE_OK) fail();
        setTimeout(timeoutSeconds);
        limitWork();
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

Handle::~Handle() {
    cache_.clear();
    queries_.clear();
    // Row sets may still hold their statements; the last of them closes for good.
    sqlite3_close_v2(db_);
}

void Handle::limitWork() {
    sqlite3_limit(db_, SQLITE_LIMIT_LENGTH, LongestValue);
    sqlite3_limit(db_, SQLITE_LIMIT_LIKE_PATTERN_LENGTH, LongestPattern);
    for (const auto& [name, arguments] : EndlessFunctions)
        sqlite3_create_function_v2(db_, name, arguments, SQLITE_UTF8, nullptr, nullptr, nullptr,
                                   nullptr, nullptr);
}

void Handle::liftLimits() {
    constexpr int MostThatThereIs = std::numeric_limits<int>::max();
    sqlite3_limit(db_, SQLITE_LIMIT_LENGTH, MostThatThereIs);
    sqlite3_progress_handler(db_, 0, nullptr, nullptr);
}

void Handle::setTimeout(int seconds) {
    if (seconds == timeout_) return;
    timeout_ = seconds;
    sqlite3_busy_handler(db_, awaitOthers, this);
    sqlite3_progress_handler(db_, StepsUnwatched, endLate, this);
}

Handle::Asking::Asking(Handle& handle) : handle_(handle) {
    handle_.isWorking_ = handle_.isGivenUp_ = false;
}

Handle::Asking::~Asking() {
    if (!handle_.waiting_) return;
    handle_.isGivenUp_ = handle_.waiting_->isGivenUp();
    handle_.waiting_.reset();
}

/// False when the operator does not want to wait any longer.
bool Handle::goesOn(const QString& what) {
    if (!waiting_) waiting_.emplace(what);
    return waiting_->goesOn();
}

/// Ends work that takes longer than the time-out, which is a second at the least.
int Handle::endLate(void* handle) {
    static const QString what = u"À espera de que o livro responda a uma consulta demorada."_s;
    auto* const self = static_cast<Handle*>(handle);
    if (!self->isWorking_) self->works_.start();
    self->isWorking_ = true;
    return self->works_.elapsed() >= qint64{qMax(1, self->timeout_)} * 1000 || !self->goesOn(what);
}

/// Waits while another program writes; 0 when the time is over. The engine's own waiting lengthens
/// its pauses to 100 ms: where several write without end, some are then kept out for seconds.
int Handle::awaitOthers(void* handle, int tries) {
    static const QString what = u"À espera de que outro programa largue o livro."_s;
    auto* const self = static_cast<Handle*>(handle);
    if (tries == 0) self->waited_.start();
    if (self->waited_.elapsed() >= qint64{self->timeout_} * 1000 || !self->goesOn(what)) return 0;
    QThread::msleep(tries == 0 ? 1 : 2);
    return 1;
}

int Handle::step(sqlite3_stmt* statement) {
    const Asking asking(*this);
    return sqlite3_step(statement);
}

int Handle::prepare(const QByteArray& text, unsigned flags, sqlite3_stmt** statement,
                    const char** tail) {
    const Asking asking(*this);
    return sqlite3_prepare_v3(db_, text.constData(), static_cast<int>(text.size()) + 1, flags,
                              statement, tail);
}

SqliteStatement Handle::prepare(const QByteArray& text) {
    sqlite3_stmt* statement = nullptr;
    const char* tail = nullptr;
    if (prepare(text, 0, &statement, &tail) != SQLITE_OK) fail();
    SqliteStatement owned(statement);
    if (!isBlank(tail) || (statement && !sqlite3_stmt_readonly(statement)))
        throw core::Failure(core::InvalidCall, u"Só é aceite uma consulta de cada vez."_s);
    return owned;
}

std::unique_ptr<SqliteQuery> Handle::take(const QString& key) {
    const auto found = queries_.find(key);
    if (found == queries_.end()) return nullptr;
    std::unique_ptr<SqliteQuery> query = std::move(found->second);
    queries_.erase(found);
    return query;
}

void Handle::keep(std::unique_ptr<SqliteQuery> query) {
    if (query->key.isEmpty()) return;
    sqlite3_reset(query->statement.get());
    sqlite3_clear_bindings(query->statement.get());
    if (queries_.size() >= CachedStatements) queries_.clear();
    QString key = query->key;
    queries_.emplace(std::move(key), std::move(query));
}

sqlite3_stmt* Handle::cached(const QByteArray& text) {
    auto found = cache_.constFind(text);
    if (found == cache_.constEnd()) {
        if (static_cast<std::size_t>(cache_.size()) >= CachedStatements) cache_.clear();
        sqlite3_stmt* statement = nullptr;
        if (prepare(text, SQLITE_PREPARE_PERSISTENT, &statement, nullptr) != SQLITE_OK) fail();
        found = cache_.insert(text, std::shared_ptr<sqlite3_stmt>(statement, sqlite3_finalize));
    }
    sqlite3_reset(found->get());
    return found->get();
}

// A long pass keeps the journal from being written back, and every attempt goes through all of it
// in vain: each one waits until the journal has grown by half since the last.
int Handle::committed(void* handle, sqlite3* db, const char* schema, int frames) {
    int& next = static_cast<Handle*>(handle)->nextCheckpoint_;
    if (frames < CheckpointFrames) next = CheckpointFrames;
    if (frames < next) return SQLITE_OK;
    int inJournal = 0;
    int writtenBack = 0;
    sqlite3_wal_checkpoint_v2(db, schema, SQLITE_CHECKPOINT_PASSIVE, &inJournal, &writtenBack);
    next = writtenBack == inJournal ? CheckpointFrames : frames + frames / 2;
    return SQLITE_OK;
}

void Handle::execute(const char* text) {
    const auto run = [&] {
        const Asking asking(*this);
        return sqlite3_exec(db_, text, nullptr, nullptr, nullptr);
    };
    if (run() != SQLITE_OK) fail();
}

void Handle::run(sqlite3_stmt* statement) {
    const int result = step(statement);
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

void Handle::fail() {
    const int code = sqlite3_extended_errcode(db_);
    // What failed for another reason just then is told as what it is: it may have been stored.
    const bool isEndedByWait = (code & 0xFF) == SQLITE_INTERRUPT || (code & 0xFF) == SQLITE_BUSY;
    if (isGivenUp_ && isEndedByWait) throw givenUp();
    if (code == SQLITE_INTERRUPT)
        throw core::Failure(
            core::DatabaseFailure,
            u"A base de dados não acabou em %1 segundos; o pedido foi interrompido."_s.arg(
                qMax(1, timeout_)),
            QString::number(code));
    const QString words = QString::fromUtf8(sqlite3_errmsg(db_));
    if ((code & 0xFF) == SQLITE_READONLY)
        throw core::Failure(
            core::DatabaseFailure,
            withDetails(noRightText(QString::fromUtf8(sqlite3_db_filename(db_, "main"))), words),
            QString::number(code));
    throw failure(code, words);
}

}  // namespace ado::sqlite
