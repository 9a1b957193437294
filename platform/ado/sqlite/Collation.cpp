// SPDX-License-Identifier: MIT
#include "platform/ado/sqlite/Collation.h"

#include <sqlite3.h>

#include <QCollator>
#include <QLocale>
#include <cstring>

#include "platform/ado/sqlite/Dialect.h"

namespace ado::sqlite {

namespace {

int byBytes(int aSize, const void* a, int bSize, const void* b) {
    const int order = std::memcmp(a, b, static_cast<std::size_t>(qMin(aSize, bSize)));
    return order != 0 ? order : aSize - bSize;
}

int compare(void*, int aSize, const void* a, int bSize, const void* b) {
    thread_local const QCollator collator(QLocale(QLocale::Portuguese, QLocale::Portugal));
    const int order = collator.compare(QString::fromUtf8(static_cast<const char*>(a), aSize),
                                       QString::fromUtf8(static_cast<const char*>(b), bSize));
    return order != 0 ? order : byBytes(aSize, a, bSize, b);
}

}  // namespace

void installCollation(sqlite3* db) {
    sqlite3_create_collation_v2(db, Collation, SQLITE_UTF8, nullptr, compare, nullptr);
}

}  // namespace ado::sqlite
