// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "platform/core/Clock.h"
#include "platform/core/Format.h"

using namespace Qt::StringLiterals;

namespace {

TEST(Dates, AreReadAsDayMonthYear) {
    core::setToday(QDate(2026, 3, 10));
    const struct {
        QString typed;
        QDate day;
    } rows[] = {
        {u"05-03-2026"_s, {2026, 3, 5}},
        {u"5/3/2026"_s, {2026, 3, 5}},
        {u"05032026"_s, {2026, 3, 5}},
        {u"050326"_s, {2026, 3, 5}},
        {u" 5.3.26 "_s, {2026, 3, 5}},
        {u"2026-03-05"_s, {2026, 3, 5}},
        {u"2027/1/31"_s, {2027, 1, 31}},
        {u"h"_s, {2026, 3, 10}},
        {u" Hoje "_s, {2026, 3, 10}},
        // Without a year, and without a month: the last such day up to today.
        {u"10-3"_s, {2026, 3, 10}},
        {u"11.03"_s, {2025, 3, 11}},
        {u"1003"_s, {2026, 3, 10}},
        {u"2211"_s, {2025, 11, 22}},
        {u"10"_s, {2026, 3, 10}},
        {u"1"_s, {2026, 3, 1}},
        {u"22"_s, {2026, 2, 22}},
        {u"29-02-2024"_s, {2024, 2, 29}},
        // Two digits mean the hundred years that end twenty years from today.
        {u"01-01-46"_s, {2046, 1, 1}},
        {u"01-01-47"_s, {1947, 1, 1}},
        {u"01-01-1753"_s, {1753, 1, 1}},
    };
    for (const auto& row : rows)
        EXPECT_EQ(core::parseDate(row.typed), row.day) << qPrintable(row.typed);
    for (const QString& none :
         {u""_s, u"29-02-2026"_s, u"29-02-1900"_s, u"01-13-2026"_s, u"1-1-1-1"_s, u"1--2026"_s,
          u"01-01-1752"_s, u"01-01-10000"_s, u"5032026"_s, u"2026-13-05"_s, u"29-2"_s, u"3102"_s,
          u"1-2026"_s, u"30"_s, u"0"_s, u"503"_s, u"hoj"_s, u"-1"_s})
        EXPECT_FALSE(core::parseDate(none)) << qPrintable(none);
    core::setToday({});
}

}  // namespace
