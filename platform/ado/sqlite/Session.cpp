// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Session.h"

#include <QDir>
#include <QThread>

#include "platform/ado/dialect/LiftedQuery.h"
#include "platform/ado/engine/EngineTexts.h"
#include "platform/ado/engine/RowStore.h"
#include "platform/ado/sqlite/Pass.h"
#include "platform/ado/sqlite/Types.h"
#include "platform/core/Failure.h"

namespace ado::sqlite {

using namespace Qt::StringLiterals;

namespace {

/// Idle readers that are kept open for the next pass.
constexpr std::size_t IdleReaders = 4;

/// Gathered writes are committed when there are so many, or after so many milliseconds: as long as
/// that others wait for the book. Each commit writes every page again that its rows touched, which
/// in an index are nearly all.
constexpr int MostGathered = 50'000;
constexpr qint64 LongestGathering = 4000;
/// Milliseconds between two gatherings: those who wait look at the book every second or third one.
constexpr unsigned long Between = 4;
/// Pages of the book that are kept, in KiB as the engine takes it. Gathered writes go to all places
/// of the indexes, and what is read meanwhile are whole tables with those they are joined to.
constexpr auto CacheOfGatheredWrites = "PRAGMA cache_size=-49152";
constexpr auto CacheOfLongReading = "PRAGMA cache_size=-24576";
constexpr auto DailyCache = "PRAGMA cache_size=-2000";

void setCache(Handle& handle, const char* size) {
    sqlite3_exec(handle.get(), size, nullptr, nullptr, nullptr);
}

QByteArray quoted(QStringView name) {
    QByteArray text = name.toUtf8();
    if (text.contains('"')) text.replace('"', "\"\"");
    return '"' + text + '"';
}

QByteArray insertText(const QString& table, const QStringList& columns) {
    const QByteArray into = "INSERT INTO " + quoted(table);
    if (columns.isEmpty()) return into + " DEFAULT VALUES";
    QByteArray names;
    QByteArray marks;
    for (const QString& column : columns) {
        names += (names.isEmpty() ? "" : ",") + quoted(column);
        marks += marks.isEmpty() ? "?" : ",?";
    }
    return into + '(' + names + ") VALUES(" + marks + ')';
}

/// "a"=? and so on, for each column.
QByteArray equal(const QStringList& columns, const char* between) {
    QByteArray text;
    for (const QString& column : columns)
        text += (text.isEmpty() ? "" : between) + quoted(column) + "=?";
    return text;
}

/// Runs a write that commits. Its commit may stand in the journal although the disk did not confirm
/// it.
template <class Write>
void committing(const Write& write) {
    try {
        write();
    } catch (const core::Failure& failure) {
        if ((failure.code().toInt() & 0xFF) == SQLITE_IOERR) throw perhapsStored(failure);
        throw;
    }
}

}  // namespace

Session::Session(const QString& folder, const QString& catalog, int timeoutSeconds)
    : file_(QDir(folder).absoluteFilePath(catalog + u".db"_s)),
      timeout_(timeoutSeconds),
      locks_(file_.path()) {
    file_.refuseForeignJournal();
    try {
        readers_.push_back(std::make_shared<Handle>(book(), Handle::Role::Reader, timeout_));
        Handle& handle = *readers_.back();
        requireContent(handle);
        // A book that cannot be written, or that somebody else has open with another journal, is
        // still readable as it is: nobody waits for it.
        handle.setTimeout(0);
        sqlite3_exec(handle.get(), "PRAGMA journal_mode=WAL", nullptr, nullptr, nullptr);
        handle.setTimeout(timeout_);
        file_.remember(handle.get());
    } catch (const core::Failure& failure) {
        if (!file_.isOpenToUser())
            throw core::Failure(failure.number(), noRightText(book()), failure.code());
        throw core::Failure(failure.number(),
                            u"Não foi possível abrir o livro «%1». %2"_s.arg(
                                QDir::toNativeSeparators(book()), failure.text()),
                            failure.code());
    }
}

/// The first read tells a book from a file that is none.
void Session::requireContent(Handle& handle) {
    sqlite3_stmt* tables = handle.cached("SELECT count(*) FROM sqlite_schema");
    if (handle.step(tables) != SQLITE_ROW) handle.fail();
    const int count = sqlite3_column_int(tables, 0);
    sqlite3_reset(tables);
    if (count == 0)
        throw core::Failure(core::DatabaseFailure,
                            u"O ficheiro está vazio. Reponha uma cópia de segurança."_s,
                            QString::number(SQLITE_NOTADB));
}

std::shared_ptr<Handle> Session::takeReader() {
    reader();
    std::shared_ptr<Handle> taken = std::move(readers_.back());
    readers_.pop_back();
    if (isGathering_) setCache(*taken, CacheOfLongReading);
    return taken;
}

void Session::giveBack(std::shared_ptr<Handle> reader) {
    if (readers_.size() < IdleReaders) readers_.push_back(std::move(reader));
}

/// A further handle on the file that the first one opened.
std::unique_ptr<Handle> Session::opened(Handle::Role role) const {
    auto handle = std::make_unique<Handle>(book(), role, timeout_);
    file_.refuseChanged(handle->get());
    return handle;
}

Handle& Session::reader() {
    if (readers_.empty()) readers_.push_back(opened(Handle::Role::Reader));
    readers_.back()->setTimeout(timeout_);
    return *readers_.back();
}

Handle& Session::writer() {
    if (!writer_) writer_ = opened(Handle::Role::Writer);
    writer_->setTimeout(timeout_);
    return *writer_;
}

void Session::setTimeout(int seconds) {
    timeout_ = seconds;
}

std::shared_ptr<ado::Pass> Session::open(const Query& statement, const QString& table) {
    file_.refuseChanged();
    commitGathered();
    const bool withIdentity = !table.isEmpty();
    return std::make_shared<Pass>(shared_from_this(), statement, withIdentity);
}

// Translating and preparing cost more than running a small statement. Those that the daily work
// sends again and again differ only in the values of their conditions and are prepared once.
std::unique_ptr<SqliteQuery> Session::prepare(Handle& handle, const Query& statement,
                                              bool withIdentity) {
    const auto lifted = LiftedQuery::from(statement);
    if (!lifted) {
        auto query = std::make_unique<SqliteQuery>();
        query->statement = handle.prepare(translate(statement, *this, withIdentity).toUtf8());
        return query;
    }
    const QString key = withIdentity ? u'*' + lifted->text : lifted->text;
    std::unique_ptr<SqliteQuery> query = handle.take(key);
    if (!query) {
        const QString text = translate(Query(lifted->text), *this, withIdentity);
        query = std::make_unique<SqliteQuery>();
        query->statement = handle.prepare(text.toUtf8());
        query->key = key;
    }
    int parameter = 0;
    for (const Cell& value : lifted->values) bind(query->statement.get(), ++parameter, value);
    return query;
}

bool Session::isTable(QStringView name) {
    if (sqlite3_table_column_metadata(reader().get(), "main", name.toUtf8().constData(), Identity,
                                      nullptr, nullptr, nullptr, nullptr, nullptr) == SQLITE_OK)
        return true;
    // The handle may know the book from before the table was made; a read looks at it anew.
    sqlite3_stmt* found = reader().cached(
        "SELECT 1 FROM sqlite_schema WHERE type='table' AND name=?1 COLLATE NOCASE "
        "AND sql NOT LIKE '%WITHOUT ROWID'");
    bind(found, 1, name.toString());
    const bool table = reader().step(found) == SQLITE_ROW;
    sqlite3_reset(found);
    return table;
}

std::optional<ColumnType> Session::columnType(QStringView table, QStringView column) {
    const char* declared = nullptr;
    if (sqlite3_table_column_metadata(reader().get(), "main", table.toUtf8().constData(),
                                      column.toUtf8().constData(), &declared, nullptr, nullptr,
                                      nullptr, nullptr) == SQLITE_OK)
        return typeOfDeclaration(declared);
    return isTable(table) ? std::nullopt : viewColumnType(table, column);
}

std::optional<ColumnType> Session::viewColumnType(QStringView view, QStringView column) {
    sqlite3_stmt* statement = nullptr;
    sqlite3_prepare_v2(reader().get(), ("SELECT * FROM " + quoted(view)).constData(), -1,
                       &statement, nullptr);
    const SqliteStatement owned(statement);
    const QByteArray wanted = column.toUtf8();
    for (int i = 0; i < sqlite3_column_count(statement); ++i)
        if (sqlite3_stricmp(sqlite3_column_name(statement, i), wanted.constData()) == 0)
            return typeOfDeclaration(sqlite3_column_decltype(statement, i));
    return std::nullopt;
}

bool Session::read(const QString& table, RowIdentity row, RowStore& into) {
    file_.refuseChanged();
    // What is gathered only the writer sees.
    Handle& handle = holdsGathered_ ? writer() : reader();
    sqlite3_stmt* statement = handle.cached("SELECT * FROM " + quoted(table) + " WHERE _rowid_=?1");
    sqlite3_bind_int64(statement, 1, row);
    const int result = handle.step(statement);
    if (result == SQLITE_ROW) {
        into.beginRow(row);
        const int columns = sqlite3_column_count(statement);
        for (int column = 0; column < columns; ++column) into.add(cellOf(statement, column));
    } else if (result != SQLITE_DONE) {
        sqlite3_reset(statement);
        handle.fail();
    }
    sqlite3_reset(statement);
    return result == SQLITE_ROW;
}

RowIdentity Session::insert(const QString& table, const QStringList& columns,
                            const std::vector<QVariant>& values, const Accompaniment& with) {
    // Many rows that are added one after the other have the same columns.
    if (inserted_.text.isEmpty() || inserted_.table != table || inserted_.columns != columns)
        inserted_ = {table, columns, insertText(table, columns)};
    RowIdentity row = NoRow;
    const auto add = [&] {
        execute(inserted_.text, values);
        row = sqlite3_last_insert_rowid(writer().get());
    };
    if (!with)
        alone(add);
    else
        together([&] {
            add();
            accompany(*with, row);
        });
    return row;
}

bool Session::update(const QString& table, RowIdentity row, const QStringList& columns,
                     const std::vector<QVariant>& values, const Accompaniment& with) {
    std::vector<QVariant> bound = values;
    bound.emplace_back(row);
    bool isThere = true;
    const auto change = [&] {
        if (columns.isEmpty()) return;
        const QByteArray changes = equal(columns, ",");
        isThere =
            execute("UPDATE " + quoted(table) + " SET " + changes + " WHERE _rowid_=?", bound) > 0;
    };
    if (!with)
        alone(change);
    else
        together([&] {
            change();
            if (isThere) accompany(*with, row);
        });
    return isThere;
}

template <class Write>
void Session::alone(const Write& write) {
    if (!isGathering_) return committing(write);
    Handle& handle = writer();
    if (!holdsGathered_) {
        file_.refuseChanged();
        handle.run(handle.cached("BEGIN IMMEDIATE"));
        holdsGathered_ = true;
        gatheredWrites_ = 0;
        gathered_.start();
    }
    try {
        write();
    } catch (...) {
        // Some failures, of the disk above all, end the transaction and what it gathered.
        holdsGathered_ = sqlite3_get_autocommit(handle.get()) == 0;
        throw;
    }
    if (++gatheredWrites_ < MostGathered && !gathered_.hasExpired(LongestGathering)) return;
    commitGathered();
    QThread::msleep(Between);
}

void Session::commitGathered() {
    if (!holdsGathered_) return;
    Handle& handle = writer();
    holdsGathered_ = false;
    try {
        committing([&] { handle.run(handle.cached("COMMIT")); });
    } catch (...) {
        sqlite3_exec(handle.get(), "ROLLBACK", nullptr, nullptr, nullptr);
        throw;
    }
}

void Session::gather() {
    setCache(writer(), CacheOfGatheredWrites);
    isGathering_ = true;
}

void Session::settle() {
    isGathering_ = false;
    for (const std::shared_ptr<Handle>& reader : readers_) setCache(*reader, DailyCache);
    commitGathered();
    setCache(writer(), DailyCache);
}

template <class Writes>
void Session::together(const Writes& writes) {
    commitGathered();
    Handle& handle = writer();
    handle.run(handle.cached("BEGIN IMMEDIATE"));
    try {
        writes();
        committing([&] { handle.run(handle.cached("COMMIT")); });
    } catch (...) {
        // Some failures have ended the transaction already.
        sqlite3_exec(handle.get(), "ROLLBACK", nullptr, nullptr, nullptr);
        throw;
    }
}

void Session::accompany(const Accompanying& with, RowIdentity row) {
    QStringList columns = with.columns;
    std::vector<QVariant> values = with.values;
    if (with.kind == Accompanying::Kind::Insert) {
        if (!with.keyColumn.isEmpty()) {
            columns += with.keyColumn;
            values.emplace_back(row);
        }
        execute(insertText(with.table, columns), values);
        return;
    }
    values.insert(values.end(), with.whereValues.begin(), with.whereValues.end());
    const QByteArray head = with.kind == Accompanying::Kind::Delete
                                ? "DELETE FROM " + quoted(with.table)
                                : "UPDATE " + quoted(with.table) + " SET " + equal(columns, ",");
    if (execute(head + " WHERE " + equal(with.whereColumns, " AND "), values) != 1)
        throw core::Failure(core::NotAccompanied, NotAccompaniedText.toString());
}

bool Session::remove(const QString& table, RowIdentity row) {
    if (removed_.table != table)
        removed_ = {table, "DELETE FROM " + quoted(table) + " WHERE _rowid_=?"};
    int removed = 0;
    alone([&] { removed = execute(removed_.text, {QVariant(row)}); });
    return removed > 0;
}

int Session::execute(const QByteArray& text, const std::vector<QVariant>& values) {
    // In the midst of a transaction the file was looked at when that began.
    if (!holdsGathered_) file_.refuseChanged();
    Handle& handle = writer();
    sqlite3_stmt* statement = handle.cached(text);
    int parameter = 0;
    for (const QVariant& value : values) bind(statement, ++parameter, value);
    handle.run(statement);
    return sqlite3_changes(handle.get());
}

std::unique_ptr<RowLock> Session::lock(const QString& table, RowIdentity row, int timeoutSeconds,
                                       RowStore& into) {
    std::unique_ptr<RowLock> lock = locks_.lock(table, row, timeoutSeconds);
    read(table, row, into);
    return lock;
}

}  // namespace ado::sqlite
