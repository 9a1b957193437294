// SPDX-License-Identifier: MIT
#include "platform/ado/PostgresPass.h"

#include "platform/ado/PostgresTypes.h"
#include "platform/ado/StatementTranslator.h"
#include "platform/core/Failure.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

/// Rows of the first batch; a set with fewer is here with one round trip.
constexpr int FirstRows = 64;
constexpr int LaterRows = 1000;

// Most statements give few rows: those are asked for at once, without a cursor.
constexpr auto OnlyFirst = " LIMIT 64";

constexpr auto Begin = "BEGIN ISOLATION LEVEL REPEATABLE READ READ ONLY";
constexpr auto FetchFirst = "FETCH 64 FROM linhas";
constexpr auto FetchLater = "FETCH 1000 FROM linhas";

}  // namespace

PostgresPass::PostgresPass(std::shared_ptr<PostgresSession> session, const QByteArray& statement,
                           bool withIdentity, bool limits)
    : session_(std::move(session)),
      reader_(session_->takeReader()),
      declare_("DECLARE linhas NO SCROLL CURSOR FOR " + statement),
      withIdentity_(withIdentity) {
    try {
        if (limits || !isShort(statement)) fetchFirst({Begin});
    } catch (...) {
        session_->giveBack(std::move(reader_));
        throw;
    }
    describeColumns();
}

bool PostgresPass::isShort(const QByteArray& statement) {
    batch_ = reader_->run(statement + OnlyFirst);
    if (PQntuples(batch_.get()) == FirstRows) return false;
    session_->giveBack(std::move(reader_));
    return true;
}

void PostgresPass::fetchFirst(const std::vector<QByteArray>& before) {
    std::vector<QByteArray> texts = before;
    texts.push_back(declare_);
    texts.push_back(FetchFirst);
    batch_ = reader_->runOpen(texts);
    row_ = -1;
    first_ = true;
    if (PQntuples(batch_.get()) < FirstRows) release();
}

void PostgresPass::describeColumns() {
    for (int place = withIdentity_ ? 1 : 0; place < PQnfields(batch_.get()); ++place) {
        Column described = describe(batch_.get(), place);
        if (described.name == QLatin1StringView(HiddenIdentity)) continue;
        columns_.push_back(std::move(described));
        places_.push_back(place);
    }
}

int PostgresPass::indexOf(QStringView name) const {
    for (int i = 0; i < columnCount(); ++i)
        if (name.compare(column(i).name, Qt::CaseInsensitive) == 0) return i;
    return -1;
}

bool PostgresPass::step() {
    if (row_ + 1 < PQntuples(batch_.get())) {
        ++row_;
        return true;
    }
    const bool last = !reader_ || (!first_ && PQntuples(batch_.get()) < LaterRows);
    if (last) return false;
    batch_ = reader_->runOpen({FetchLater});
    first_ = false;
    row_ = 0;
    return PQntuples(batch_.get()) > 0;
}

Cell PostgresPass::cell(int column) const {
    return cellOf(batch_.get(), row_, places_[static_cast<std::size_t>(column)]);
}

RowIdentity PostgresPass::identity() const {
    return withIdentity_ ? cellOf(batch_.get(), row_, 0).integer : 0;
}

void PostgresPass::restart() {
    if (first_)
        row_ = -1;
    else
        fetchFirst({"CLOSE linhas"});
}

void PostgresPass::release() {
    if (!reader_) return;
    reader_->send("COMMIT");
    session_->giveBack(std::move(reader_));
}

}  // namespace ado
