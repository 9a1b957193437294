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
        const char* text;
        qint64 units;
    } rows[] = {
        {"0", 0},
        {"-0", 0},
        {"12", 120000},
        {"+12.5", 125000},
        {"-12.3456", -123456},
        {".5", 5000},
        {"5.", 50000},
        {"0.00005", 1},  // halves go away from zero
        {"-0.00005", -1},
        {"0.000049999", 0},  // the fifth decimal alone decides
        {"0.99995", 10000},
        {"0007.1", 71000},
        {"922337203685477.5807", Most},
    };
    for (const auto& row : rows) {
        const std::optional<Money> read = Money::fromPlainText(QString::fromLatin1(row.text));
        ASSERT_TRUE(read) << row.text;
        EXPECT_EQ(read->units(), row.units) << row.text;
    }
}

TEST(Money, RefusesWhatIsNoPlainNumberOrDoesNotFit) {
    for (const char* text : {"", "-", ".", "--1", "1-", "1.2.3", "1,2", "1e5", "abc", " 1", "0x1",
                             "922337203685477.5808", "922337203685477.58075", "9223372036854775807",
                             "99999999999999999999999999"})
        EXPECT_FALSE(Money::fromPlainText(QString::fromLatin1(text))) << text;
}

TEST(Money, GoesThroughPlainTextUnchanged) {
    for (const qint64 units : {qint64{0}, qint64{1}, qint64{-1}, qint64{9999}, qint64{-10000},
                               qint64{123456789}, Most, -Most}) {
        const QString text = Money::fromUnits(units).toPlainText();
        const std::optional<Money> back = Money::fromPlainText(text);
        ASSERT_TRUE(back) << text.toStdString();
        EXPECT_EQ(back->units(), units) << text.toStdString();
    }
    EXPECT_EQ(Money::fromUnits(-5).toPlainText(), u"-0.0005"_s);
    EXPECT_EQ(Money::fromUnits(std::numeric_limits<qint64>::min()).toPlainText(),
              u"-922337203685477.5808"_s);
}

TEST(Money, RoundsADoubleToTheNearestUnit) {
    EXPECT_EQ(Money::fromDouble(87.35).units(), 873500);
    EXPECT_EQ(Money::fromDouble(-0.00005).units(), -1);
    EXPECT_EQ(Money::fromDouble(0.00004999).units(), 0);
    // 0.1 + 0.2 is not 0.3 as a double; to four decimals it is.
    EXPECT_EQ(Money::fromDouble(0.1 + 0.2), Money::fromDouble(0.3));
    for (const double amount : {1e15, -1e15, 1e300, double(INFINITY), double(NAN)})
        EXPECT_THROW((void)Money::fromDouble(amount), core::Failure) << amount;
}

TEST(Money, SumsAreExactAndNeverWrap) {
    const Money difference = Money::fromDouble(0.4) - Money::fromDouble(0.3);
    EXPECT_FALSE(difference > Money::fromDouble(0.1));
    EXPECT_EQ(difference, Money::fromDouble(0.1));
    const Money most = Money::fromUnits(Most);
    const Money least = Money::fromUnits(std::numeric_limits<qint64>::min());
    const Money unit = Money::fromUnits(1);
    EXPECT_THROW((void)(most + unit), core::Failure);
    EXPECT_THROW((void)(least - unit), core::Failure);
    EXPECT_THROW((void)-least, core::Failure);
    EXPECT_EQ((most - unit + unit).units(), Most);
}

}  // namespace
