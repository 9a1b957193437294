// SPDX-License-Identifier: MIT
#include "platform/ado/SqlitePass.h"

#include "platform/ado/SqliteTypes.h"

namespace ado {

namespace {

/// Steps after which a pass counts as long: from then on it can be restarted over the same rows.
constexpr qint64 LongPass = 32;

}  // namespace

SqlitePass::SqlitePass(std::shared_ptr<SqliteSession> session, const QByteArray& text,
                       bool withIdentity)
    : session_(std::move(session)), reader_(session_->takeReader()), first_(withIdentity ? 1 : 0) {
    try {
        statement_ = reader_->prepare(text);
    } catch (...) {
        session_->giveBack(std::move(reader_));
        throw;
    }
    columns_ = sqlite3_column_count(statement_.get()) - first_;
}

SqlitePass::~SqlitePass() {
    release();
}

const Column& SqlitePass::column(int column) const {
    if (described_.empty()) described_.resize(static_cast<std::size_t>(columns_));
    Column& known = described_[static_cast<std::size_t>(column)];
    if (known.name.isNull())
        known = describe(sqlite3_column_name(statement_.get(), column + first_),
                         sqlite3_column_decltype(statement_.get(), column + first_));
    return known;
}

int SqlitePass::indexOf(QStringView name) const {
    const QByteArray wanted = name.toUtf8();
    for (int column = 0; column < columns_; ++column)
        if (sqlite3_stricmp(sqlite3_column_name(statement_.get(), column + first_),
                            wanted.constData()) == 0)
            return column;
    return -1;
}

bool SqlitePass::step() {
    if (++steps_ == LongPass && !held_) {
        reader_->run(reader_->cached("BEGIN"));
        held_ = true;
    }
    const int result = sqlite3_step(statement_.get());
    if (result == SQLITE_ROW) return true;
    if (result != SQLITE_DONE) reader_->fail();
    return false;
}

Cell SqlitePass::cell(int column) const {
    return cellOf(statement_.get(), column + first_);
}

void SqlitePass::restart() {
    sqlite3_reset(statement_.get());
}

void SqlitePass::release() {
    if (!reader_) return;
    sqlite3_reset(statement_.get());
    if (held_) sqlite3_exec(reader_->get(), "COMMIT", nullptr, nullptr, nullptr);
    session_->giveBack(std::move(reader_));
}

}  // namespace ado
