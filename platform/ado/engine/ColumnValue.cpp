// SPDX-License-Identifier: MIT
#include "platform/ado/engine/ColumnValue.h"

#include <QDateTime>
#include <charconv>
#include <cmath>

#include "platform/core/Failure.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

namespace ado {

using namespace Qt::StringLiterals;

namespace {

[[noreturn]] void overflow(const Column& column, const QString& value) {
    throw core::Failure(core::Overflow,
                        u"O valor %1 não cabe na coluna «%2»."_s.arg(value, column.name));
}

/// Reads up to four digits; -1 when none stands there.
int digits(QStringView text, qsizetype& at) {
    int number = -1;
    for (int taken = 0; taken < 4 && at < text.size() && text[at] >= u'0' && text[at] <= u'9';
         ++taken, ++at)
        number = qMax(number, 0) * 10 + (text[at].unicode() - u'0');
    return number;
}

bool skip(QStringView text, qsizetype& at, QChar mark) {
    if (at >= text.size() || text[at] != mark) return false;
    ++at;
    return true;
}

QDate parseDay(QStringView text, qsizetype& at) {
    const int first = digits(text, at);
    const bool isYear = at == 4;
    const QChar mark = at < text.size() ? text[at] : QChar();
    if (mark != u'-' && mark != u'/') return {};
    ++at;
    const int second = digits(text, at);
    if (!skip(text, at, mark)) return {};
    const int third = digits(text, at);
    if (mark == u'-') return isYear ? QDate(first, second, third) : QDate();
    return third < 100 ? QDate() : QDate(third, first, second);
}

QTime parseTime(QStringView text, qsizetype& at) {
    if (at == text.size()) return QTime(0, 0);
    if (!skip(text, at, u' ') && !skip(text, at, u'T')) return {};
    while (skip(text, at, u' ')) continue;
    const int hour = digits(text, at);
    if (!skip(text, at, u':')) return {};
    const int minute = digits(text, at);
    int second = 0;
    if (skip(text, at, u':')) second = digits(text, at);
    if (skip(text, at, u'.')) digits(text, at);  // fractions of a second are not kept
    return at == text.size() ? QTime(hour, minute, second) : QTime();
}

/// A number of two or four digits; a negative one when there is another character among them.
int fixedDigits(const char* at, int length) {
    int value = 0;
    for (; length > 0; --length, ++at) {
        const int digit = *at - '0';
        if (digit < 0 || digit > 9) return -10000;
        value = value * 10 + digit;
    }
    return value;
}

/// Days from 1970-01-01 of a day of the proleptic Gregorian calendar (Howard Hinnant's
/// days_from_civil, for years from 1 on).
qint64 daysFromCivil(int year, int month, int day) {
    year -= month <= 2;
    const int era = year / 400;
    const int yearOfEra = year - era * 400;
    const int dayOfYear = (153 * (month + (month > 2 ? -3 : 9)) + 2) / 5 + day - 1;
    const int dayOfEra = yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear;
    return qint64{era} * 146097 + dayOfEra - 719468;
}

/// The form that the book stores, read without detours: every list and report goes through here.
QVariant storedMoment(std::string_view text) {
    const char* c = text.data();
    if (text.size() == 19 && c[4] == '-' && c[7] == '-' && c[13] == ':' && c[16] == ':') {
        const int year = fixedDigits(c, 4);
        const int month = fixedDigits(c + 5, 2);
        const int day = fixedDigits(c + 8, 2);
        const int hour = fixedDigits(c + 11, 2);
        const int minute = fixedDigits(c + 14, 2);
        const int second = fixedDigits(c + 17, 2);
        const bool moment = year > 0 && month > 0 && month <= 12 && day > 0 &&
                            (day <= 28 || day <= QDate(year, month, 1).daysInMonth()) &&
                            hour >= 0 && hour < 24 && minute >= 0 && minute < 60 && second >= 0 &&
                            second < 60;
        if (moment) {
            const qint64 seconds =
                daysFromCivil(year, month, day) * 86400 + hour * 3600 + minute * 60 + second;
            return QDateTime::fromMSecsSinceEpoch(seconds * 1000, Qt::UTC);
        }
    }
    const QString plain = QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
    const QDateTime moment = parseMoment(plain);
    return moment.isValid() ? QVariant(moment) : QVariant(plain);
}

QVariant integerVariant(qint64 number, ColumnType type) {
    switch (type) {
        case ColumnType::Integer16:
        case ColumnType::Integer32:
            if (number == static_cast<qint32>(number)) return static_cast<qint32>(number);
            break;
        case ColumnType::Money: {
            qint64 units = 0;
            if (!__builtin_mul_overflow(number, 10000, &units))
                return QVariant::fromValue(core::Money::fromUnits(units));
            break;
        }
        case ColumnType::Single:
            return static_cast<float>(number);
        case ColumnType::Double:
            return static_cast<double>(number);
        default:
            break;
    }
    return QVariant(static_cast<qlonglong>(number));
}

QVariant realVariant(double number, ColumnType type) {
    switch (type) {
        case ColumnType::Money: {
            // What was stored as an amount is at most a hair beside its fourth decimal.
            const double nearest = std::nearbyint(number * 10000);
            if (std::fabs(number) < 1e10 && std::fabs(number * 10000 - nearest) < 0.01)
                return QVariant::fromValue(core::Money::fromUnits(static_cast<qint64>(nearest)));
            if (std::fabs(number) < 9e14)
                return QVariant::fromValue(core::Money::fromDouble(number));
            return number;
        }
        case ColumnType::Single:
            return static_cast<float>(number);
        default:
            return number;
    }
}

QVariant textVariant(std::string_view text, ColumnType type) {
    if (type == ColumnType::DateTime) return storedMoment(text);
    const QString plain = QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size()));
    if (type == ColumnType::Money)
        if (const auto money = core::Money::fromPlainText(plain))
            return QVariant::fromValue(*money);
    return plain;
}

/// Numbers past the range of any column are told from what is no number at all.
void refuseInfinity(const QVariant& value, const Column& column) {
    bool infinite = false;
    if (value.typeId() == QMetaType::Double || value.typeId() == QMetaType::Float) {
        infinite = std::isinf(value.toDouble());
    } else if (value.typeId() == QMetaType::QString) {
        const QByteArray text = value.toString().trimmed().toUtf8();
        double number = 0;
        const auto read = std::from_chars(text.begin(), text.end(), number);
        infinite = read.ec == std::errc::result_out_of_range && read.ptr == text.end();
    }
    if (infinite) overflow(column, core::toText(value));
}

qint64 toWhole(const QVariant& value, const Column& column, qint64 lowest, qint64 highest) {
    bool exact = false;
    qint64 whole = value.typeId() == QMetaType::Double || value.typeId() == QMetaType::Float
                       ? 0
                       : value.toLongLong(&exact);
    if (!exact) {
        const double rounded = std::nearbyint(core::toDouble(value));
        if (!(std::fabs(rounded) < 9.2e18)) overflow(column, core::toText(value));
        whole = static_cast<qint64>(rounded);
    }
    if (whole < lowest || whole > highest) overflow(column, core::toText(value));
    return whole;
}

core::Money toMoney(const QVariant& value) {
    if (value.typeId() == qMetaTypeId<core::Money>()) return value.value<core::Money>();
    if (value.typeId() == QMetaType::QString)
        if (const auto money = core::Money::fromPlainText(value.toString().trimmed()))
            return *money;
    return core::Money::fromDouble(core::toDouble(value));
}

QVariant toMoment(const QVariant& value, const Column& column) {
    QDateTime moment;
    if (value.typeId() == QMetaType::QDate)
        moment = QDateTime(value.toDate(), QTime(0, 0), Qt::UTC);
    else if (value.typeId() == QMetaType::QDateTime)
        moment = value.toDateTime();
    else if (value.typeId() == QMetaType::QString)
        moment = parseMoment(QStringView(value.toString()).trimmed());
    const int year = moment.date().year();
    if (!moment.isValid() || year < 1 || year > 9999)
        throw core::Failure(core::TypeMismatch, u"«%1» não é uma data (coluna «%2»)."_s.arg(
                                                    core::toText(value), column.name));
    const QTime time = moment.time();
    return QDateTime(moment.date(), QTime(time.hour(), time.minute(), time.second()), Qt::UTC);
}

qsizetype characters(const QString& text) {
    qsizetype count = 0;
    for (const QChar c : text) count += !c.isLowSurrogate();
    return count;
}

QVariant toTextValue(const QVariant& value, const Column& column) {
    QString text = value.typeId() == QMetaType::QDateTime ? storedForm(value.toDateTime())
                                                          : core::toText(value);
    if (text.contains(QChar(u'\0')))
        throw core::Failure(core::TypeMismatch,
                            u"O texto da coluna «%1» tem um carácter nulo, que a base de dados não "
                            u"guarda."_s.arg(column.name));
    if (column.definedSize > 0 && text.size() > column.definedSize) {
        const qsizetype length = characters(text);
        if (length > column.definedSize)
            throw core::Failure(
                core::Overflow,
                u"O texto tem %1 caracteres; a coluna «%2» guarda no máximo %3."_s.arg(length)
                    .arg(column.name)
                    .arg(column.definedSize));
    }
    if (text.isNull()) text = u""_s;
    return text;
}

}  // namespace

QVariant toVariant(const Cell& cell, ColumnType type) {
    switch (cell.kind) {
        case Cell::Null:
            return {};
        case Cell::Integer:
            return integerVariant(cell.integer, type);
        case Cell::Real:
            return realVariant(cell.real, type);
        case Cell::Text:
            return textVariant(cell.text, type);
    }
    return {};
}

QVariant toColumn(const QVariant& value, const Column& column) {
    if (core::isNull(value) && value.typeId() != QMetaType::QString) return {};
    if (!value.isValid()) return {};
    const bool numeric = column.type >= ColumnType::Integer16 && column.type <= ColumnType::Money;
    if (numeric) refuseInfinity(value, column);
    switch (column.type) {
        case ColumnType::Integer16:
            return static_cast<qint32>(toWhole(value, column, -32768, 32767));
        case ColumnType::Integer32:
            return static_cast<qint32>(toWhole(value, column, -2147483648LL, 2147483647));
        case ColumnType::Integer64:
            return QVariant(static_cast<qlonglong>(toWhole(value, column, INT64_MIN, INT64_MAX)));
        case ColumnType::Single:
            return core::toSingle(value) + 0.0F;  // no negative zero
        case ColumnType::Double:
            return core::toDouble(value) + 0.0;
        case ColumnType::Money:
            return QVariant::fromValue(toMoney(value));
        case ColumnType::DateTime:
            return toMoment(value, column);
        case ColumnType::Text:
            return toTextValue(value, column);
        case ColumnType::Other:
            return value;
    }
    return value;
}

QString storedForm(const QDateTime& moment) {
    const QDate day = moment.date();
    const QTime time = moment.time();
    QString text = u"0000-00-00 00:00:00"_s;
    const auto write = [&text](qsizetype last, int number) {
        for (; number > 0; number /= 10, --last) text[last] = QChar(u'0' + number % 10);
    };
    write(3, day.year());
    write(6, day.month());
    write(9, day.day());
    write(12, time.hour());
    write(15, time.minute());
    write(18, time.second());
    return text;
}

QDateTime parseMoment(QStringView text) {
    qsizetype at = 0;
    const QDate day = parseDay(text, at);
    if (!day.isValid()) return {};
    const QTime time = parseTime(text, at);
    return time.isValid() ? QDateTime(day, time, Qt::UTC) : QDateTime();
}

}  // namespace ado
