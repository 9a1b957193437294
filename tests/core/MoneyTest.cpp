// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "platform/core/Failure.h"
#include "platform/core/Money.h"

using core::Money;
using namespace Qt::StringLiterals;

namespace {

constexpr qint64 Most = std::numeric_limits<qint64>::max();

TEST(Money, IsReadFromPlainTextToFourDecimals) {
    const struct {
        QString text;
        qint64 units;
    } rows[] = {
        {u"-0"_s, 0},
        {u"-12.3456"_s, -123456},
        {u".5"_s, 5000},
        {u"0.00005"_s, 1},  // halves go away from zero
        {u"-0.00005"_s, -1},
        {u"0.000049999"_s, 0},  // the fifth decimal alone decides
        {u"922337203685477.5807"_s, Most},
    };
    for (const auto& row : rows)
        EXPECT_EQ(Money::fromPlainText(row.text), Money::fromUnits(row.units))
            << qPrintable(row.text);
    for (const QString& none :
         {u""_s, u"-"_s, u"."_s, u"1.2.3"_s, u"1,2"_s, u"1e5"_s, u" 1"_s, u"0x1"_s,
          u"922337203685477.5808"_s, u"922337203685477.58075"_s, u"99999999999999999999999999"_s})
        EXPECT_FALSE(Money::fromPlainText(none)) << qPrintable(none);
}

TEST(Money, RoundsADoubleAndItsSumsAreExactAndNeverWrap) {
    EXPECT_EQ(Money::fromDouble(87.35).units(), 873500);
    EXPECT_EQ(Money::fromDouble(-0.00005).units(), -1);
    EXPECT_EQ(Money::fromDouble(0.00004999).units(), 0);
    for (const double amount : {1e15, -1e15, double(INFINITY), double(NAN)})
        EXPECT_THROW((void)Money::fromDouble(amount), core::Failure) << amount;
    // Not so as doubles.
    EXPECT_EQ(Money::fromDouble(0.4) - Money::fromDouble(0.3), Money::fromDouble(0.1));
    const Money most = Money::fromUnits(Most);
    const Money least = Money::fromUnits(std::numeric_limits<qint64>::min());
    EXPECT_THROW((void)(most + Money::fromUnits(1)), core::Failure);
    EXPECT_THROW((void)(least - Money::fromUnits(1)), core::Failure);
    EXPECT_THROW((void)-least, core::Failure);
}

}  // namespace
