// SPDX-License-Identifier: MIT
#include <sqlite3.h>

#include <cstdio>
#include <cstdlib>

#include "benchmarks/BareBulk.h"

namespace benchmarks {

namespace {

constexpr int WritesOfACommit = 50'000;

class BareBulkSqlite final : public BareBulk {
public:
    explicit BareBulkSqlite(const Book& book) : file_(book.file().toUtf8()), writer_(connect()) {
        run("PRAGMA cache_size=-49152");
        run("BEGIN IMMEDIATE");
    }
    ~BareBulkSqlite() override { sqlite3_close(writer_); }

    void each(const QByteArray& query, const std::vector<BareWrite>& writes) override {
        commit();
        sqlite3* const reader = connect();
        sqlite3_stmt* const rows = prepare(reader, query);
        std::vector<sqlite3_stmt*> prepared;
        for (const BareWrite& write : writes) prepared.push_back(prepare(writer_, write.text));
        while (sqlite3_step(rows) == SQLITE_ROW) {
            for (std::size_t at = 0; at < writes.size(); ++at) {
                int place = 0;
                for (const int column : writes[at].columns)
                    sqlite3_bind_value(prepared[at], ++place, sqlite3_column_value(rows, column));
                if (sqlite3_step(prepared[at]) != SQLITE_DONE) stop(writer_, writes[at].text);
                sqlite3_reset(prepared[at]);
            }
            written_ += static_cast<int>(writes.size());
            if (written_ >= WritesOfACommit) commit();
        }
        for (sqlite3_stmt* each : prepared) sqlite3_finalize(each);
        sqlite3_finalize(rows);
        sqlite3_close(reader);
    }

    qint64 read(const QByteArray& query) override {
        sqlite3_stmt* const rows = prepare(writer_, query);
        qint64 count = 0;
        for (; sqlite3_step(rows) == SQLITE_ROW; ++count)
            for (int column = 0; column < sqlite3_column_count(rows); ++column)
                seen_ += sqlite3_value_bytes(sqlite3_column_value(rows, column));
        sqlite3_finalize(rows);
        return count;
    }

    void finish() override { run("COMMIT"); }

private:
    [[noreturn]] static void stop(sqlite3* handle, const QByteArray& query) {
        std::fprintf(stderr, "%s: %s\n", sqlite3_errmsg(handle), query.constData());
        std::exit(1);
    }
    sqlite3* connect() const {
        sqlite3* handle = nullptr;
        if (sqlite3_open_v2(file_, &handle, SQLITE_OPEN_READWRITE, nullptr) != SQLITE_OK)
            stop(handle, "open");
        for (const char* setting : {"PRAGMA journal_mode=WAL", "PRAGMA synchronous=FULL"})
            sqlite3_exec(handle, setting, nullptr, nullptr, nullptr);
        return handle;
    }
    static sqlite3_stmt* prepare(sqlite3* handle, const QByteArray& query) {
        sqlite3_stmt* prepared = nullptr;
        if (sqlite3_prepare_v2(handle, query, -1, &prepared, nullptr) != SQLITE_OK)
            stop(handle, query);
        return prepared;
    }
    void run(const char* text) {
        if (sqlite3_exec(writer_, text, nullptr, nullptr, nullptr) != SQLITE_OK)
            stop(writer_, text);
    }
    void commit() {
        run("COMMIT");
        run("BEGIN IMMEDIATE");
        written_ = 0;
    }

    QByteArray file_;
    sqlite3* writer_;
    int written_ = 0;  ///< since the last commit
    qint64 seen_ = 0;  ///< bytes; that the values are really taken
};

}  // namespace

std::unique_ptr<BareBulk> bareBulkSqlite(const Book& book) {
    return std::make_unique<BareBulkSqlite>(book);
}

}  // namespace benchmarks
