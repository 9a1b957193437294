// SPDX-License-Identifier: MIT
// The queries' texts, letter by letter.
#include "reports/ExtractQuery.h"

#include <gtest/gtest.h>

#include <QFile>

using namespace Qt::StringLiterals;

namespace reports {

namespace {

TEST(ExtractQueries, AreJoinedToTheLetter) {
    QFile file(QStringLiteral(QUERIES_FILE));
    ASSERT_TRUE(file.open(QIODevice::ReadOnly));
    for (const bool detailed : {true, false})
        for (const bool byDocument : {false, true}) {
            SCOPED_TRACE(testing::Message() << detailed << byDocument);
            const Selection selection{.socio_id = 7,
                                      .detailed = detailed,
                                      .byDocument = byDocument,
                                      .first = QDate(2026, 3, 1),
                                      .last = QDate(2026, 12, 31),
                                      .doc_no = u"FT 1'2"_s};
            EXPECT_EQ(extractQuery(selection).toStdString() + '\n', file.readLine().toStdString());
        }
    EXPECT_TRUE(file.atEnd());
}

}  // namespace

}  // namespace reports
