// SPDX-License-Identifier: MIT
#include "platform/core/Money.h"

#include <cmath>

#include "platform/core/Failure.h"

namespace core {

namespace {

[[noreturn]] void overflow() {
    throw Failure(Overflow, QStringLiteral("O valor não cabe num montante."));
}

}  // namespace

Money Money::fromDouble(double amount) {
    // long double keeps 64 bits of mantissa, so that the product does not move a value across a
    // half that the double itself does not reach.
    const long double scaled = std::round(static_cast<long double>(amount) * 10000.0L);
    if (!(scaled >= -9223372036854775807.0L && scaled <= 9223372036854775807.0L)) overflow();
    return Money(static_cast<qint64>(scaled));
}

std::optional<Money> Money::fromPlainText(QStringView text) {
    qsizetype at = 0;
    const bool negative = text.startsWith(u'-');
    if (negative || text.startsWith(u'+')) ++at;
    qint64 units = 0;
    int decimals = -1;  // -1 until the point has been seen
    bool digits = false;
    bool roundUp = false;
    for (; at < text.size(); ++at) {
        const char16_t c = text[at].unicode();
        if (c == u'.' && decimals < 0) {
            decimals = 0;
            continue;
        }
        if (c < u'0' || c > u'9') return std::nullopt;
        digits = true;
        if (decimals == 4) {
            roundUp = c >= u'5';
            decimals = 5;
        }
        if (decimals > 4) continue;
        if (__builtin_mul_overflow(units, 10, &units) ||
            __builtin_add_overflow(units, c - u'0', &units))
            return std::nullopt;
        if (decimals >= 0) ++decimals;
    }
    if (!digits) return std::nullopt;
    for (int missing = qMax(decimals, 0); missing < 4; ++missing)
        if (__builtin_mul_overflow(units, 10, &units)) return std::nullopt;
    if (roundUp && __builtin_add_overflow(units, 1, &units)) return std::nullopt;
    return Money(negative ? -units : units);
}

QString Money::toPlainText() const {
    const quint64 magnitude =
        units_ < 0 ? quint64{0} - static_cast<quint64>(units_) : static_cast<quint64>(units_);
    const QString digits = QString::number(magnitude).rightJustified(5, u'0');
    return (units_ < 0 ? QStringLiteral("-") : QString()) + digits.chopped(4) + u'.' +
           digits.right(4);
}

Money operator+(Money a, Money b) {
    Money sum;
    if (__builtin_add_overflow(a.units_, b.units_, &sum.units_)) overflow();
    return sum;
}

Money operator-(Money a, Money b) {
    Money difference;
    if (__builtin_sub_overflow(a.units_, b.units_, &difference.units_)) overflow();
    return difference;
}

Money Money::operator-() const {
    return Money() - *this;
}

}  // namespace core
