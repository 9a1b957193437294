// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "platform/core/Failure.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

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
    return QVariant::fromValue(core::Money::fromDouble(amount));
}

TEST(Values, BecomeWholeNumbersByTheEvenNeighbourOrFail) {
    const struct {
        double value;
        int whole;
    } rows[] = {{0.5, 0}, {1.5, 2}, {2.5, 2}, {-0.5, 0}, {-1.5, -2}, {586.4999, 586}, {2.51, 3}};
    for (const auto& row : rows) {
        EXPECT_EQ(core::toLong(row.value), row.whole) << row.value;
        EXPECT_EQ(core::toInteger(row.value), row.whole) << row.value;
    }
    EXPECT_EQ(failureOf([] { core::toInteger(32767.5); }), core::Overflow);
    EXPECT_EQ(core::toLong(2147483647.0), 2147483647);
    EXPECT_EQ(failureOf([] { core::toLong(2147483647.5); }), core::Overflow);
}

TEST(Values, NullEmptyAndZeroAreThreeThings) {
    EXPECT_TRUE(core::isNull(Null));
    EXPECT_FALSE(core::isNull(u""_s));
    EXPECT_TRUE(core::isNullOrEmpty(u""_s));
    EXPECT_FALSE(core::isNullOrEmpty(0));
    EXPECT_EQ(failureOf([] { core::toDouble(Null); }), core::InvalidUseOfNull);
    EXPECT_EQ(failureOf([] { core::toLong(Null); }), core::InvalidUseOfNull);
    EXPECT_FALSE(core::compareNumbers(Null, 0) > 0);
    EXPECT_FALSE(core::compareNumbers(0, Null) < 0);
    EXPECT_FALSE(core::compareNumbers(Null, Null) == 0);
    EXPECT_TRUE(core::compareNumbers(money(0.1), 0.1) == 0);
    EXPECT_TRUE(core::compareNumbers(2, money(2.0001)) < 0);
}

TEST(Values, AreReadFromTextsWithADecimalPoint) {
    EXPECT_EQ(core::toDouble(u"12.5"_s), 12.5);
    for (const QString& text : {u""_s, u"12,5"_s, u"abc"_s, u"1e400"_s, u"nan"_s, u"inf"_s})
        EXPECT_EQ(failureOf([&] { core::toDouble(text); }), core::TypeMismatch) << qPrintable(text);
}

TEST(Values, SinglesNeverBecomeInfinite) {
    EXPECT_EQ(core::toSingle(16777217.0), 16777216.0f);
    EXPECT_EQ(core::toSingle(money(87.35)), 87.35f);
    EXPECT_EQ(failureOf([] { core::toSingle(-1e39); }), core::Overflow);
}

}  // namespace
