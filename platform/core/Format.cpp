// SPDX-License-Identifier: MIT
#include "platform/core/Format.h"

#include <QDateTime>
#include <cmath>

#include "platform/core/Clock.h"
#include "platform/core/Money.h"
#include "platform/core/Values.h"

namespace core {

namespace {

constexpr double MostMoney = 9e14;  // a round figure inside the range of money

/// A number cut to cents for the eye, halves away from zero.
struct Cents {
    bool negative = false;
    QString whole;  ///< digits before the mark
    QString part;   ///< the two behind it
    bool isZero() const { return whole == QStringLiteral("0") && part == QStringLiteral("00"); }
};

Cents cents(Money amount) {
    // From the exact digits: a double does not hold all of them.
    const qint64 units = amount.units();
    const qint64 rest = units % 100;
    const qint64 rounded = units / 100 + (rest >= 50 ? 1 : rest <= -50 ? -1 : 0);
    const QString digits = QString::number(rounded < 0 ? -rounded : rounded);
    const QString padded = digits.rightJustified(3, u'0');
    return {units < 0, padded.chopped(2), padded.right(2)};
}

Cents cents(const QVariant& value) {
    if (value.typeId() == qMetaTypeId<Money>()) return cents(value.value<Money>());
    const double number = toDouble(value);
    // Engines give a computed column as a double, which lies beside most decimals: 1.005 is a
    // little less, and would lose the cent that a sum over the same rows shows.
    if (std::abs(number) < MostMoney) return cents(Money::fromDouble(number));
    const QString plain = QString::number(std::abs(number), 'f', 2);
    return {number < 0, plain.chopped(3), plain.right(2)};
}

QString withMarks(QString digits, const QLocale& locale) {
    const QChar mark = thousandsMark(locale);
    for (qsizetype at = digits.size() - 3; at > 0; at -= 3) digits.insert(at, mark);
    return digits;
}

QString shown(const Cents& cents, const QLocale& locale) {
    return withMarks(cents.whole, locale) + decimalMark(locale) + cents.part;
}

bool isNumber(const QVariant& value) {
    switch (value.typeId()) {
        case QMetaType::Int:
        case QMetaType::LongLong:
        case QMetaType::Short:
        case QMetaType::Float:
        case QMetaType::Double:
            return true;
        default:
            return value.typeId() == qMetaTypeId<Money>();
    }
}

QString formattedNumber(const QVariant& value, QStringView format, const QLocale& locale) {
    const bool isAmount = format.startsWith(format::Amount);
    const bool isFraction = format == format::Fraction;
    if (format != format::Money && !isAmount && format != format::Rate && !isFraction)
        return toText(value).replace(u'.', decimalMark(locale));
    const Cents rounded = cents(value);
    // What shows as nothing has no sign.
    const bool negative = rounded.negative && !rounded.isZero();
    if (format == format::Money) {
        const QString amount = QStringLiteral("€ ") + shown(rounded, locale);
        return negative ? u'(' + amount + u')' : amount;
    }
    const QString sign = negative ? QStringLiteral("-") : QString();
    if (!isAmount)
        return sign + rounded.whole.rightJustified(isFraction ? 1 : 2, u'0') + decimalMark(locale) +
               rounded.part;
    const QStringView unit = format.sliced(format::Amount.size());
    return sign + shown(rounded, locale) + unit.toString();
}

/// Takes the currency sign, brackets and sign off; false when they do not pair.
bool stripSigns(QString& text, bool& negative) {
    text = text.trimmed();
    if (text.startsWith(u'(') != text.endsWith(u')')) return false;
    negative = text.startsWith(u'(');
    if (negative) text = text.mid(1, text.size() - 2).trimmed();
    if (text.startsWith(u'€')) text = text.mid(1).trimmed();
    if (text.endsWith(u'€')) text = text.chopped(1).trimmed();
    if (text.startsWith(u'-') || text.startsWith(u'+')) {
        if (negative) return false;
        negative = text.startsWith(u'-');
        text = text.mid(1).trimmed();
    }
    return true;
}

/// Takes the thousands marks out of the whole part; false when one stands in the wrong place.
bool stripThousands(QString& whole) {
    const QStringList groups = whole.split(thousandsMark());
    for (qsizetype at = 0; at < groups.size(); ++at) {
        const qsizetype length = groups[at].size();
        if (at > 0 ? length != 3 : groups.size() > 1 && (length < 1 || length > 3)) return false;
    }
    whole = groups.join(QString());
    return true;
}

bool onlyDigits(QStringView text) {
    return std::all_of(text.begin(), text.end(), [](QChar c) { return c >= u'0' && c <= u'9'; });
}

}  // namespace

const QLocale& portugueseLocale() {
    static const QLocale locale(QLocale::Portuguese, QLocale::Portugal);
    return locale;
}

QLocale userLocale() {
    const QLocale system = QLocale::system();
    return system.language() == QLocale::C ? portugueseLocale() : system;
}

QChar decimalMark(const QLocale& locale) {
    return locale.decimalPoint() == QStringLiteral(".") ? u'.' : u',';
}

QChar thousandsMark(const QLocale& locale) {
    return decimalMark(locale) == u',' ? u'.' : u',';
}

QString formatted(const QVariant& value, QStringView format, const QLocale& locale) {
    if (isNull(value)) return {};
    if (value.typeId() == QMetaType::QDateTime || value.typeId() == QMetaType::QDate)
        return toDate(value).toString(QStringLiteral("dd-MM-yyyy"));
    if (isNumber(value)) return formattedNumber(value, format, locale);
    return toText(value);
}

QString grouped(qint64 number, const QLocale& locale) {
    const QString digits = QString::number(number);
    return number < 0 ? u'-' + withMarks(digits.mid(1), locale) : withMarks(digits, locale);
}

std::optional<QString> parseDecimal(const QString& typed) {
    QString text = typed;
    bool negative = false;
    if (!stripSigns(text, negative)) return std::nullopt;
    const qsizetype mark = text.indexOf(decimalMark());
    QString whole = mark < 0 ? text : text.left(mark);
    const QString decimals = mark < 0 ? QString() : text.mid(mark + 1);
    if (!stripThousands(whole) || !onlyDigits(whole) || !onlyDigits(decimals) ||
        whole.size() + decimals.size() == 0)
        return std::nullopt;
    QString plain = whole.isEmpty() ? QStringLiteral("0") : whole;
    if (!decimals.isEmpty()) plain += u'.' + decimals;
    const bool zero =
        std::all_of(plain.begin(), plain.end(), [](QChar c) { return c == u'0' || c == u'.'; });
    return negative && !zero ? u'-' + plain : plain;
}

std::optional<double> parseNumber(const QString& text) {
    const std::optional<QString> plain = parseDecimal(text);
    if (!plain) return std::nullopt;
    bool ok = false;
    const double number = plain->toDouble(&ok);
    if (!ok || !std::isfinite(number)) return std::nullopt;
    return number;
}

namespace {

/// Years outside this range are typing mistakes, and not every engine stores them.
std::optional<QDate> dayOf(int year, int month, int day) {
    const QDate date(year, month, day);
    return year >= 1753 && date.isValid() ? std::optional(date) : std::nullopt;
}

/// Two digits mean the hundred years that end twenty years from now.
int wholeYear(const QString& digits) {
    const int year = digits.toInt();
    if (digits.size() > 2) return year;
    const int newest = today().year() + 20;
    const int whole = year + newest - newest % 100;
    return whole > newest ? whole - 100 : whole;
}

/// The first of the two days that is there and not in the future.
std::optional<QDate> passed(const QDate& first, const QDate& second) {
    for (const QDate& day : {first, second})
        if (day.isValid() && day <= today()) return day;
    return std::nullopt;
}

/// Digits without marks between them, parted: "221126", "22112026", "2211".
QStringList partedDigits(const QString& digits) {
    switch (digits.size()) {
        case 4:
            return {digits.left(2), digits.right(2)};
        case 6:
        case 8:
            return {digits.left(2), digits.mid(2, 2), digits.mid(4)};
        default:
            return {digits};
    }
}

}  // namespace

std::optional<QDate> parseDate(const QString& typed) {
    QString text = typed.trimmed().toLower();
    if (text == QStringLiteral("h") || text == QStringLiteral("hoje")) return today();
    text.replace(u'/', u'-').replace(u'.', u'-');
    const QStringList parts = text.contains(u'-') ? text.split(u'-') : partedDigits(text);
    for (const QString& part : parts)
        if (part.isEmpty() || part.size() > 4 || !onlyDigits(part)) return std::nullopt;
    const int first = parts[0].toInt();
    const QDate now = today();
    if (parts.size() == 3 && parts[0].size() == 4)
        return dayOf(first, parts[1].toInt(), parts[2].toInt());
    if (parts.size() == 3) return dayOf(wholeYear(parts[2]), parts[1].toInt(), first);
    if (parts[0].size() > 2) return std::nullopt;
    if (parts.size() == 2 && parts[1].size() <= 2) {
        const int month = parts[1].toInt();
        return passed(QDate(now.year(), month, first), QDate(now.year() - 1, month, first));
    }
    if (parts.size() > 1) return std::nullopt;
    const QDate before = now.addMonths(-1);
    return passed(QDate(now.year(), now.month(), first),
                  QDate(before.year(), before.month(), first));
}

}  // namespace core
