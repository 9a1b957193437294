// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Pass.h"

#include "platform/ado/sqlite/Types.h"

namespace ado::sqlite {

namespace {

/// Steps after which a pass counts as long: from then on it can be restarted over the same rows.
constexpr qint64 LongPass = 32;

}  // namespace

Pass::Pass(std::shared_ptr<Session> session, const Query& statement, bool withIdentity)
    : session_(std::move(session)), reader_(session_->takeReader()), first_(withIdentity ? 1 : 0) {
    try {
        query_ = session_->prepare(*reader_, statement, withIdentity);
    } catch (...) {
        session_->giveBack(reader_);
        throw;
    }
    statement_ = query_->statement.get();
    columns_ = sqlite3_column_count(statement_) - first_;
}

Pass::~Pass() {
    release();
    reader_->keep(std::move(query_));
}

/// The table was altered since the query was prepared.
void Pass::describeAnew() {
    query_->described.clear();
    columns_ = sqlite3_column_count(statement_) - first_;
}

const Column& Pass::column(int column) const {
    std::vector<Column>& described = query_->described;
    if (described.empty()) described.resize(static_cast<std::size_t>(columns_));
    Column& known = described[static_cast<std::size_t>(column)];
    if (known.name.isNull())
        known = describe(sqlite3_column_name(statement_, column + first_),
                         sqlite3_column_decltype(statement_, column + first_));
    return known;
}

int Pass::indexOf(QStringView name) const {
    const QByteArray wanted = name.toUtf8();
    for (int column = 0; column < columns_; ++column)
        if (sqlite3_stricmp(sqlite3_column_name(statement_, column + first_), wanted.constData()) ==
            0)
            return column;
    return -1;
}

/// From here on the reader sees the rows of this moment, until it is released.
void Pass::hold() {
    if (held_) return;
    reader_->run(reader_->cached("BEGIN"));
    held_ = true;
}

bool Pass::step() {
    if (++steps_ == LongPass) hold();
    const int result = reader_->step(statement_);
    if (steps_ == 1 && sqlite3_stmt_status(statement_, SQLITE_STMTSTATUS_REPREPARE, 1) > 0)
        describeAnew();
    if (result == SQLITE_ROW) return true;
    if (result != SQLITE_DONE) reader_->fail();
    return false;
}

Cell Pass::cell(int column) const {
    return cellOf(statement_, column + first_);
}

void Pass::restart() {
    sqlite3_reset(statement_);
}

// The engine counts without making the rows, which takes half the time.
qint64 Pass::rowsInAll() {
    hold();
    const std::unique_ptr<char, decltype(&sqlite3_free)> text(sqlite3_expanded_sql(statement_),
                                                              &sqlite3_free);
    const SqliteStatement count =
        reader_->prepare(QByteArray("SELECT count(*) FROM (") + text.get() + ')');
    if (reader_->step(count.get()) != SQLITE_ROW) reader_->fail();
    return sqlite3_column_int64(count.get(), 0);
}

void Pass::release() {
    if (!leased_) return;
    leased_ = false;
    sqlite3_reset(statement_);
    if (held_) sqlite3_exec(reader_->get(), "COMMIT", nullptr, nullptr, nullptr);
    session_->giveBack(reader_);
}

}  // namespace ado::sqlite
