// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QDateTime>

#include "platform/core/Format.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

using core::formatted;
using core::Money;
using namespace Qt::StringLiterals;
namespace format = core::format;

namespace {

QVariant money(const char* plain) {
    return QVariant::fromValue(*Money::fromPlainText(QString::fromLatin1(plain)));
}

TEST(Format, WithoutASystemLocaleThePortugueseOneHolds) {
    EXPECT_EQ(core::userLocale().name(), u"pt_PT"_s);
    EXPECT_EQ(core::decimalMark(), u',');
    EXPECT_EQ(core::thousandsMark(), u'.');
}

TEST(Format, AmountsShowCentsThousandsAndBrackets) {
    const struct {
        QVariant value;
        QStringView format;
        QString shown;
    } rows[] = {
        {money("1234.56"), format::Money, u"€ 1.234,56"_s},
        {money("-5"), format::Money, u"(€ 5,00)"_s},
        {money("0"), format::Money, u"€ 0,00"_s},
        {money("999999.995"), format::Money, u"€ 1.000.000,00"_s},
        {money("-1234567.8"), format::Money, u"(€ 1.234.567,80)"_s},
        {money("0.005"), format::Money, u"€ 0,01"_s},
        {money("0.0049"), format::Money, u"€ 0,00"_s},
        {money("-0.0049"), format::Money, u"€ 0,00"_s},
        {money("9999999999999.9949"), format::Money, u"€ 9.999.999.999.999,99"_s},
        {100, format::Money, u"€ 100,00"_s},
        {87.35f, format::Money, u"€ 87,35"_s},
        {money("5.86"), format::Amount, u"5,86"_s},
        {money("-1234.5"), format::Amount, u"-1.234,50"_s},
        {5.0f, format::Rate, u"05,00"_s},
        {23, format::Rate, u"23,00"_s},
        {u"abc"_s, format::Money, u"abc"_s},
        {money("1234.5"), {}, u"1234,5"_s},
        {1234567, format::Number, u"1234567"_s},
        {u"100015"_s, format::Number, u"100015"_s},
        {QVariant(), format::Money, QString()},
        {QDateTime(QDate(2024, 2, 29), QTime(13, 5), Qt::UTC), format::Date, u"29-02-2024"_s},
    };
    for (const auto& row : rows)
        EXPECT_EQ(formatted(row.value, row.format).toStdString(), row.shown.toStdString());
}

TEST(Format, NumbersAreReadAsPeopleTypeThem) {
    const struct {
        QString typed;
        QString plain;
    } rows[] = {
        {u"1.234,56"_s, u"1234.56"_s},
        {u"1234,56"_s, u"1234.56"_s},
        {u"12.345.678"_s, u"12345678"_s},
        {u" 87,35 "_s, u"87.35"_s},
        {u"€ 1.234,56"_s, u"1234.56"_s},
        {u"5 €"_s, u"5"_s},
        {u"(€ 5,00)"_s, u"-5.00"_s},
        {u"(5)"_s, u"-5"_s},
        {u"-5"_s, u"-5"_s},
        {u"+5"_s, u"5"_s},
        {u",5"_s, u"0.5"_s},
        {u"5,"_s, u"5"_s},
        {u"-0"_s, u"0"_s},
        {u"-0,00"_s, u"0.00"_s},
        {u"0,1234567890123456789"_s, u"0.1234567890123456789"_s},
    };
    for (const auto& row : rows)
        EXPECT_EQ(core::parseDecimal(row.typed).value_or(u"nothing"_s).toStdString(),
                  row.plain.toStdString())
            << row.typed.toStdString();
    EXPECT_FALSE(std::signbit(*core::parseNumber(u"-0"_s)));
}

TEST(Format, MarksInTheWrongPlaceAndOtherNotationsAreNoNumber) {
    for (const QString& typed : {u""_s,
                                 u" "_s,
                                 u"1,234.56"_s,
                                 u"87.35"_s,
                                 u"1e400"_s,
                                 u"1e5"_s,
                                 u"1.23.4"_s,
                                 u"--1"_s,
                                 u"-(5)"_s,
                                 u"(-5)"_s,
                                 u"(5"_s,
                                 u"5)"_s,
                                 u"1,2,3"_s,
                                 u".123"_s,
                                 u"1234.567"_s,
                                 u"1..234"_s,
                                 u"abc"_s,
                                 u"12a"_s,
                                 u"0x10"_s,
                                 u"nan"_s,
                                 u"inf"_s,
                                 u"€"_s,
                                 u"-"_s,
                                 u","_s,
                                 u"()"_s,
                                 u"1 2"_s,
                                 u"١٢"_s,
                                 u"1'"_s,
                                 QString(u"1"_s) + QChar(0)})
        EXPECT_FALSE(core::parseDecimal(typed)) << typed.toStdString();
    // All digits are kept, but a number must be finite.
    EXPECT_TRUE(core::parseDecimal(QString(400, u'9')));
    EXPECT_FALSE(core::parseNumber(QString(400, u'9')));
}

TEST(Format, WhatIsShownIsReadBack) {
    for (const char* plain : {"0", "0.01", "-0.01", "1234.56", "-1234567.89", "999999999.99"}) {
        const QVariant value = money(plain);
        for (const QStringView shown : {format::Money, format::Amount, QStringView()}) {
            const std::optional<QString> read = core::parseDecimal(formatted(value, shown));
            ASSERT_TRUE(read) << plain;
            EXPECT_EQ(Money::fromPlainText(*read), value.value<Money>()) << plain;
        }
    }
}

}  // namespace
