// SPDX-License-Identifier: MIT
#include <sqlite3.h>

#include <QHash>
#include <cstdio>
#include <cstdlib>

#include "benchmarks/Bare.h"

namespace benchmarks {

namespace {

class BareSqliteRows final : public BareRows {
public:
    BareSqliteRows(sqlite3* handle, sqlite3_stmt* rows) : handle_(handle), rows_(rows) {}
    ~BareSqliteRows() override {
        sqlite3_finalize(rows_);
        sqlite3_close(handle_);
    }

    bool next() override { return sqlite3_step(rows_) == SQLITE_ROW; }
    qint64 integer(int column) const override { return sqlite3_column_int64(rows_, column); }
    double real(int column) const override { return sqlite3_column_double(rows_, column); }
    const char* text(int column) const override {
        return reinterpret_cast<const char*>(sqlite3_column_text(rows_, column));
    }

private:
    sqlite3* handle_;
    sqlite3_stmt* rows_;
};

/// With the settings that a book is opened with.
class BareSqlite final : public Bare {
public:
    explicit BareSqlite(const QString& file) : file_(file), handle_(connect()) {}
    ~BareSqlite() override {
        for (sqlite3_stmt* each : kept_) sqlite3_finalize(each);
        sqlite3_close(handle_);
    }

    double run(const QByteArray& query, const Values& values, int column) override {
        sqlite3_stmt*& kept = kept_[query];
        if (!kept) kept = prepare(handle_, query);
        int place = 0;
        for (const BareValue& value : values) bind(kept, ++place, value);
        double found = 0;
        int step = sqlite3_step(kept);
        if (step == SQLITE_ROW) found = sqlite3_column_double(kept, column);
        while (step == SQLITE_ROW) step = sqlite3_step(kept);
        if (step != SQLITE_DONE) stop(handle_, query);
        sqlite3_reset(kept);
        return found;
    }

    std::unique_ptr<BareRows> rows(const QByteArray& query) override {
        sqlite3* reader = connect();
        return std::make_unique<BareSqliteRows>(reader, prepare(reader, query));
    }

private:
    [[noreturn]] static void stop(sqlite3* handle, const QByteArray& query) {
        std::fprintf(stderr, "%s: %s\n", sqlite3_errmsg(handle), query.constData());
        std::exit(1);
    }

    sqlite3* connect() const {
        sqlite3* handle = nullptr;
        if (sqlite3_open_v2(file_.toUtf8().constData(), &handle, SQLITE_OPEN_READWRITE, nullptr) !=
            SQLITE_OK)
            stop(handle, "open");
        for (const char* setting : {"PRAGMA journal_mode=WAL", "PRAGMA synchronous=FULL"})
            sqlite3_exec(handle, setting, nullptr, nullptr, nullptr);
        sqlite3_busy_timeout(handle, 30000);
        return handle;
    }

    static sqlite3_stmt* prepare(sqlite3* handle, const QByteArray& query) {
        sqlite3_stmt* prepared = nullptr;
        if (sqlite3_prepare_v2(handle, query.constData(), static_cast<int>(query.size()), &prepared,
                               nullptr) != SQLITE_OK)
            stop(handle, query);
        return prepared;
    }

    static void bind(sqlite3_stmt* prepared, int place, const BareValue& value) {
        if (const auto* number = std::get_if<qint64>(&value))
            sqlite3_bind_int64(prepared, place, *number);
        else if (const auto* real = std::get_if<double>(&value))
            sqlite3_bind_double(prepared, place, *real);
        else
            sqlite3_bind_text(prepared, place, std::get<const char*>(value), -1, SQLITE_STATIC);
    }

    QString file_;
    sqlite3* handle_;
    QHash<QByteArray, sqlite3_stmt*> kept_;
};

}  // namespace

std::unique_ptr<Bare> bareSqlite(const Book& book) {
    return std::make_unique<BareSqlite>(book.file());
}

}  // namespace benchmarks
