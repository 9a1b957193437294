// SPDX-License-Identifier: MIT
#pragma once

#include <QLocale>
#include <QString>
#include <QVariant>
#include <optional>

namespace core {

/// Display formats of the screens and reports. They touch what is shown, never what is stored.
namespace format {
inline constexpr QStringView Money = u"€ #,##0.00;(€ #,##0.00)";
inline constexpr QStringView Amount = u"#,##0.00";
inline constexpr QStringView Escudos = u"#,##0.00 Esc";
inline constexpr QStringView Rate = u"00.00";
inline constexpr QStringView Fraction = u"0$00";
inline constexpr QStringView Date = u"dd-MM-yyyy";
inline constexpr QStringView Number = u"@@@@@.@";
}  // namespace format

/// The locale of what leaves the house on paper or in files, whoever makes it: Portugal's.
const QLocale& portugueseLocale();
/// The locale in which people type and read: the user's; where the system has none (C, POSIX) the
/// Portuguese one.
QLocale userLocale();
/// The decimal separator of a locale, and the mark between thousands: a point beside a decimal
/// comma, a comma beside a decimal point.
QChar decimalMark(const QLocale& locale = userLocale());
QChar thousandsMark(const QLocale& locale = userLocale());

/// Shows a value in a display format; null gives empty text. An empty format, "@@@@@.@" and a value
/// that the format does not fit (a text in a money format) give the plain text of the value,
/// numbers with the locale's decimal mark.
QString formatted(const QVariant& value, QStringView format, const QLocale& locale = userLocale());

/// A whole number with the marks between thousands that amounts have.
QString grouped(qint64 number, const QLocale& locale = userLocale());

/// Reads a number as a person types it or as formatted() shows it: optional currency sign, sign or
/// brackets, thousands marks only where they belong, one decimal mark. Exponents, letters and marks
/// in the wrong place give nothing, and so does an empty text.
std::optional<double> parseNumber(const QString& text);
/// The same as plain decimal text with a point, all digits kept.
std::optional<QString> parseDecimal(const QString& text);

/// Reads a date as a person types it: day, month, year with "-", "/", "." or nothing between them,
/// a year of two or four digits; year, month, day with a year of four digits first; "h" or "hoje".
/// Without a year ("22-11", "2211") the last such day that is not in the future is meant, of this
/// year or the last one; without a month ("22") that of this month or the last one. Nothing when
/// there is no such day.
std::optional<QDate> parseDate(const QString& text);

}  // namespace core
