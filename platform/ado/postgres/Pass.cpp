// SPDX-License-Identifier: MIT
#include "platform/ado/postgres/Pass.h"

#include "platform/ado/postgres/Dialect.h"
#include "platform/ado/postgres/Types.h"
#include "platform/core/Failure.h"

namespace ado::postgres {

using namespace Qt::StringLiterals;

namespace {

// Most statements give few rows: those are asked for at once, without a cursor.
constexpr auto OnlyFirst = " LIMIT 64";

constexpr auto Begin = "BEGIN ISOLATION LEVEL REPEATABLE READ READ ONLY";
constexpr auto FetchFirst = "FETCH 64 FROM linhas";
constexpr auto FetchLater = "FETCH 1000 FROM linhas";
constexpr auto MoveBehindLast = "MOVE FORWARD ALL FROM linhas";
// Rows that were asked for ahead wait on the server until somebody wants them, maybe over lunch.
constexpr auto NoTimeout = "SET LOCAL statement_timeout = 0";

/// True when a statement may say by itself how many rows it wants, or when asking for the first
/// ones alone saves nothing: all rows of a union are found and compared before the first one is
/// known.
bool wantsCursor(const Query& statement) {
    for (int i = 0; i < statement.count(); ++i)
        for (const auto word : {"limit"_L1, "fetch"_L1, "offset"_L1, "for"_L1, "union"_L1})
            if (statement.is(i, word)) return true;
    return false;
}

}  // namespace

Pass::Pass(std::shared_ptr<Session> session, const Query& statement, bool withIdentity)
    : session_(std::move(session)), reader_(session_->takeReader()), withIdentity_(withIdentity) {
    try {
        if (wantsCursor(statement) || !isShort(statement)) {
            declare_ = "DECLARE linhas NO SCROLL CURSOR FOR " +
                       session_->translated(statement, withIdentity);
            fetchFirst(Begin);
        }
    } catch (...) {
        session_->giveBack(std::move(reader_));
        throw;
    }
    describeColumns();
}

bool Pass::isShort(const Query& statement) {
    batch_ = session_->firstRows(*reader_, statement, withIdentity_, OnlyFirst);
    if (count() == FirstRows) return false;
    session_->giveBack(std::move(reader_));
    return true;
}

void Pass::fetchFirst(const QByteArray& before) {
    reader_->ask({before, declare_, FetchFirst});
    batch_ = reader_->answer();
    before_ = 0;
    row_ = -1;
    first_ = true;
    if (count() < FirstRows) release();
}

void Pass::describeColumns() {
    for (int place = withIdentity_ ? 1 : 0; place < PQnfields(batch_.get()); ++place) {
        Column described = describe(batch_.get(), place);
        if (described.name == QLatin1StringView(HiddenIdentity)) continue;
        columns_.push_back(std::move(described));
        places_.push_back(place);
    }
}

int Pass::indexOf(QStringView name) const {
    for (int i = 0; i < columnCount(); ++i)
        if (name.compare(column(i).name, Qt::CaseInsensitive) == 0) return i;
    return -1;
}

bool Pass::step() {
    if (row_ + 1 < count()) {
        ++row_;
        return true;
    }
    if (isWhole()) return false;
    if (first_) reader_->ask({NoTimeout, FetchLater});
    before_ += count();
    batch_ = reader_->answer();
    first_ = false;
    row_ = 0;
    if (!isWhole()) reader_->ask({FetchLater});
    return count() > 0;
}

Cell Pass::cell(int column) const {
    const auto at = static_cast<std::size_t>(column);
    return cellOf(batch_.get(), row_, places_[at], columns_[at].type);
}

RowIdentity Pass::identity() const {
    return withIdentity_ ? cellOf(batch_.get(), row_, 0).integer : 0;
}

void Pass::restart() {
    if (first_)
        row_ = -1;
    else
        fetchFirst("CLOSE linhas");
}

// The server counts without sending the rows.
qint64 Pass::rowsInAll() {
    if (isWhole()) return before_ + count();
    qint64 rows = before_ + count();
    if (!first_) rows += PQntuples(reader_->answer().get());
    reader_->ask({NoTimeout, MoveBehindLast});
    rows += QByteArray(PQcmdTuples(reader_->answer().get())).toLongLong();
    first_ = false;
    return rows;
}

void Pass::release() {
    if (!reader_) return;
    reader_->finish();
    session_->giveBack(std::move(reader_));
}

}  // namespace ado::postgres
