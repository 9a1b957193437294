// SPDX-License-Identifier: MIT
#include "SmallBook.h"

using namespace Qt::StringLiterals;

namespace {

class LongNumbers : public SmallBook {};

// 19 digits may fit 64 bits, 20 and more do not.
TEST_F(LongNumbers, InAConditionKeepTheirValue) {
    book.exec(
        u"INSERT INTO tbMov(grande) VALUES(0), (999999999999999999), (9223372036854775807)"_s);
    const struct {
        QString condition, found;
    } rows[] = {
        {u"grande = 999999999999999999"_s, u"2"_s},
        {u"grande = 9223372036854775807"_s, u"3"_s},
        {u"grande >= 1000000000000000000"_s, u"3"_s},
        {u"grande < 1000000000000000000"_s, u"1,2"_s},
        {u"grande < 10000000000000000000"_s, u"1,2,3"_s},
        {u"grande < 100000000000000000000000"_s, u"1,2,3"_s},
        {u"grande < 1000000000000000000000000"_s, u"1,2,3"_s},
    };
    for (const auto& row : rows)
        EXPECT_EQ(
            valuesOf(open(u"select id from tbMov where "_s + row.condition, connection), u"id"_s),
            row.found)
            << qPrintable(row.condition);
}

}  // namespace
