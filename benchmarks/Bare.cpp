// SPDX-License-Identifier: MIT
#include "benchmarks/Bare.h"

#include <cstdio>
#include <cstdlib>

namespace benchmarks {

namespace {

[[noreturn]] void stop(sqlite3* handle, const char* statement) {
    std::fprintf(stderr, "%s: %s\n", sqlite3_errmsg(handle), statement);
    std::exit(1);
}

}  // namespace

Bare::Bare(const QString& file) {
    if (sqlite3_open_v2(file.toUtf8().constData(), &handle_, SQLITE_OPEN_READWRITE, nullptr) !=
        SQLITE_OK)
        stop(handle_, "open");
    run("PRAGMA journal_mode=WAL");
    run("PRAGMA synchronous=FULL");
    sqlite3_busy_timeout(handle_, 30000);
}

Bare::~Bare() {
    sqlite3_close(handle_);
}

double Bare::run(const QByteArray& statement, int column) {
    sqlite3_stmt* prepared = nullptr;
    if (sqlite3_prepare_v2(handle_, statement.constData(), static_cast<int>(statement.size()),
                           &prepared, nullptr) != SQLITE_OK)
        stop(handle_, statement.constData());
    double value = 0;
    int step = sqlite3_step(prepared);
    if (step == SQLITE_ROW) value = sqlite3_column_double(prepared, column);
    while (step == SQLITE_ROW) step = sqlite3_step(prepared);
    if (step != SQLITE_DONE) stop(handle_, statement.constData());
    sqlite3_finalize(prepared);
    return value;
}

}  // namespace benchmarks
