// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <QDateTime>

#include "platform/core/Format.h"
#include "platform/core/Money.h"

using core::Money;
using namespace Qt::StringLiterals;
namespace format = core::format;

namespace {

QVariant money(const char* plain) {
    return QVariant::fromValue(*Money::fromPlainText(QString::fromLatin1(plain)));
}

TEST(Format, ShowsValuesAsAPortugueseReaderExpects) {
    const struct {
        QVariant value;
        QStringView format;
        QString shown;
    } rows[] = {
        {money("1234.56"), format::Money, u"€ 1.234,56"_s},
        {money("-1234567.8"), format::Money, u"(€ 1.234.567,80)"_s},
        {money("999999.995"), format::Money, u"€ 1.000.000,00"_s},
        {money("0.0049"), format::Money, u"€ 0,00"_s},
        {money("-0.0049"), format::Money, u"€ 0,00"_s},
        {87.35f, format::Money, u"€ 87,35"_s},
        {1.005, format::Money, u"€ 1,01"_s},
        {-2.675, format::Amount, u"-2,68"_s},
        {1e17, format::Amount, u"100.000.000.000.000.000,00"_s},
        {QVariant(), format::Money, QString()},
        {money("-1234.5"), format::Amount, u"-1.234,50"_s},
        {money("-1234.5"), format::Escudos, u"-1.234,50 Esc"_s},
        {QDateTime(QDate(2024, 2, 29), QTime(13, 5), Qt::UTC), format::Date, u"29-02-2024"_s},
    };
    for (const auto& row : rows) EXPECT_EQ(core::formatted(row.value, row.format), row.shown);
    EXPECT_EQ(core::grouped(1007388), u"1.007.388"_s);
    EXPECT_EQ(core::grouped(-999), u"-999"_s);
}

TEST(Format, ReadsNumbersAsPeopleTypeThem) {
    const struct {
        QString typed;
        QString plain;
    } rows[] = {
        {u"1.234,56"_s, u"1234.56"_s}, {u"1234,56"_s, u"1234.56"_s},
        {u" 87,35 "_s, u"87.35"_s},    {u"€ 1.234,56"_s, u"1234.56"_s},
        {u"(€ 5,00)"_s, u"-5.00"_s},   {u"-5"_s, u"-5"_s},
        {u",5"_s, u"0.5"_s},           {u"5,"_s, u"5"_s},
        {u"-0,00"_s, u"0.00"_s},       {u"0,1234567890123456789"_s, u"0.1234567890123456789"_s},
    };
    for (const auto& row : rows)
        EXPECT_EQ(core::parseDecimal(row.typed), row.plain) << qPrintable(row.typed);
    for (const QString& none :
         {u""_s, u"1,234.56"_s, u"87.35"_s, u"1e400"_s, u"1.23.4"_s, u"(-5)"_s, u"(5"_s, u"1,2,3"_s,
          u".123"_s, u"12a"_s, u"nan"_s, u"€"_s, u","_s, u"1 2"_s, u"١٢"_s})
        EXPECT_FALSE(core::parseDecimal(none)) << qPrintable(none);
    // All digits are kept, but a number must be finite.
    EXPECT_TRUE(core::parseDecimal(QString(400, u'9')));
    EXPECT_FALSE(core::parseNumber(QString(400, u'9')));
}

}  // namespace
