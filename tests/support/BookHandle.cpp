// SPDX-License-Identifier: MIT
#include "tests/support/BookHandle.h"

#include "tests/support/PostgresBook.h"
#include "tests/support/SqliteBook.h"

namespace support {

bool onServer() {
    static const bool server = qgetenv("ZELMARS_TEST_ENGINE") == "postgresql";
    return server;
}

std::unique_ptr<BookHandle> BookHandle::make(Content content, const QString& folder) {
    if (onServer()) return std::make_unique<PostgresBook>(content);
    return std::make_unique<SqliteBook>(content, folder);
}

QString printed(double number) {
    return QString::number(number, 'g', 15);
}

}  // namespace support
