// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QDateTime>
#include <limits>

#include "platform/core/Failure.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

using core::Money;
using namespace Qt::StringLiterals;

namespace {

const QVariant Null;

/// The number of the failure, 0 for none.
template <class Statement>
int failureOf(Statement&& statement) {
    try {
        statement();
        return 0;
    } catch (const core::Failure& failure) {
        return failure.number();
    }
}

QVariant money(double amount) {
    return QVariant::fromValue(Money::fromDouble(amount));
}

TEST(Values, HalvesGoToTheEvenNeighbour) {
    const struct {
        double value;
        int whole;
    } rows[] = {{0.5, 0}, {1.5, 2}, {2.5, 2}, {-0.5, 0}, {-1.5, -2}, {586.4999, 586}, {2.51, 3}};
    for (const auto& row : rows) {
        EXPECT_EQ(core::toLong(row.value), row.whole) << row.value;
        EXPECT_EQ(core::toInteger(row.value), row.whole) << row.value;
    }
}

TEST(Values, WholeNumbersThatDoNotFitFail) {
    EXPECT_EQ(core::toInteger(32767), 32767);
    EXPECT_EQ(core::toInteger(-32768.5), -32768);
    EXPECT_EQ(failureOf([] { core::toInteger(32767.5); }), core::Overflow);
    EXPECT_EQ(failureOf([] { core::toInteger(-32769); }), core::Overflow);
    EXPECT_EQ(core::toLong(2147483647.0), 2147483647);
    EXPECT_EQ(failureOf([] { core::toLong(2147483647.5); }), core::Overflow);
    EXPECT_EQ(failureOf([] { core::toLong(-2147483649.0); }), core::Overflow);
    EXPECT_EQ(failureOf([] { core::toLong(1e300); }), core::Overflow);
}

TEST(Values, NullEmptyAndZeroAreThreeThings) {
    EXPECT_TRUE(core::isNull(Null));
    EXPECT_TRUE(core::isNull(QVariant(QString())) || core::isNullOrEmpty(QString()));
    EXPECT_FALSE(core::isNull(u""_s));
    EXPECT_FALSE(core::isNull(0));
    EXPECT_TRUE(core::isNullOrEmpty(u""_s));
    EXPECT_FALSE(core::isNullOrEmpty(0));
    EXPECT_FALSE(core::isNullOrEmpty(u" "_s));
    EXPECT_EQ(failureOf([] { core::toDouble(Null); }), core::InvalidUseOfNull);
    EXPECT_EQ(failureOf([] { core::toLong(Null); }), core::InvalidUseOfNull);
    EXPECT_EQ(failureOf([] { core::toDouble(u""_s); }), core::TypeMismatch);
    EXPECT_EQ(core::toDouble(0), 0.0);
    EXPECT_EQ(core::toText(Null), QString());
}

TEST(Values, TextsAreReadWithADecimalPoint) {
    EXPECT_EQ(core::toDouble(u"12.5"_s), 12.5);
    for (const char* text : {"12,5", "abc", "1e400", "nan", "inf", "'; drop table x"})
        EXPECT_EQ(failureOf([text] { core::toDouble(QString::fromLatin1(text)); }),
                  core::TypeMismatch)
            << text;
}

TEST(Values, SinglesKeepSevenDigitsAndNeverBecomeInfinite) {
    EXPECT_EQ(core::toSingle(16777217.0), 16777216.0f);
    EXPECT_EQ(core::toSingle(money(87.35)), 87.35f);
    EXPECT_EQ(failureOf([] { core::toSingle(1e39); }), core::Overflow);
    EXPECT_EQ(failureOf([] { core::toSingle(-1e39); }), core::Overflow);
}

TEST(Values, TextsOfValuesAreWhatAStatementCanHold) {
    EXPECT_EQ(core::toText(money(12.5)), u"12.5"_s);
    EXPECT_EQ(core::toText(money(1200)), u"1200"_s);
    EXPECT_EQ(core::toText(money(-0.0001)), u"-0.0001"_s);
    EXPECT_EQ(core::toText(87.35f), u"87.3499985"_s);
    EXPECT_EQ(core::toText(87.35), u"87.35"_s);
    EXPECT_EQ(core::toText(5), u"5"_s);
    EXPECT_EQ(core::toText(5.0), u"5"_s);
}

TEST(Values, ComparisonsWithNullDoNotHold) {
    EXPECT_FALSE(core::compareNumbers(Null, 0) > 0);
    EXPECT_FALSE(core::compareNumbers(0, Null) < 0);
    EXPECT_FALSE(core::compareNumbers(Null, Null) == 0);
    EXPECT_TRUE(core::compareNumbers(money(0.1), 0.1) == 0);
    EXPECT_TRUE(core::compareNumbers(2, money(2.0001)) < 0);
    EXPECT_TRUE(core::compareNumbers(u"3"_s, 2.5f) > 0);
}

TEST(Values, ADayIsHeldAsItsFirstInstantWithoutAZone) {
    const QDate day(2024, 2, 29);
    const QVariant held = core::fromDate(day);
    EXPECT_EQ(core::toDate(held), day);
    EXPECT_EQ(held.toDateTime().time(), QTime(0, 0));
    EXPECT_EQ(held.toDateTime().timeSpec(), Qt::UTC);
    EXPECT_FALSE(core::toDate(Null).isValid());
}

}  // namespace
