// SPDX-License-Identifier: MIT
#include "tests/support/BookHandle.h"

using namespace Qt::StringLiterals;

namespace support {

bool onServer() {
    static const bool server = qgetenv("ZELMARS_TEST_ENGINE") == "postgresql";
    return server;
}

std::unique_ptr<BookHandle> BookHandle::make(Content content, const QString& folder) {
    return onServer() ? makeOnServer(content) : makeFile(content, folder);
}

QString BookHandle::connectionString() const {
    return u"Provider=SQLOLEDB.1;Persist Security Info=True;User ID=%1;Password=;"
           "Initial Catalog=%2;Data Source=%3;Connect Timeout=15"_s.arg(user(), catalogue(),
                                                                        dataSource());
}

QString BookHandle::shapingConnectionString() const {
    return connectionString().replace(u"Provider=SQLOLEDB.1"_s,
                                      u"Provider=MSDataShape.1;Data Provider=SQLOLEDB.1"_s);
}

QString printed(double number) {
    return QString::number(number, 'g', 15);
}

}  // namespace support
