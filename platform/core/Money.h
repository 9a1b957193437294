// SPDX-License-Identifier: MIT
#pragma once

#include <QMetaType>
#include <QString>
#include <compare>
#include <optional>

namespace core {

/// An amount with four decimals, exact. The range is about ±922 337 203 685 477.
class Money {
public:
    constexpr Money() = default;
    /// @param units  ten-thousandths of the currency
    static constexpr Money fromUnits(qint64 units) { return Money(units); }
    /// Rounds to four decimals, halves away from zero. Fails with Overflow past the range and on
    /// what is no number.
    static Money fromDouble(double amount);
    /// Reads plain decimal text as databases write it ("-12.3456"); more decimals are rounded,
    /// halves away from zero. Nothing when it is no number or does not fit.
    static std::optional<Money> fromPlainText(QStringView text);

    constexpr qint64 units() const { return units_; }
    /// The double nearest to the amount.
    double toDouble() const { return static_cast<double>(units_) / 10000.0; }
    /// Plain decimal text with a point and exactly four decimals.
    QString toPlainText() const;

    /// Sums fail with Overflow past the range.
    friend Money operator+(Money a, Money b);
    friend Money operator-(Money a, Money b);
    Money operator-() const;
    friend constexpr auto operator<=>(Money, Money) = default;

private:
    explicit constexpr Money(qint64 units) : units_(units) {}
    qint64 units_ = 0;
};

}  // namespace core

Q_DECLARE_METATYPE(core::Money)
