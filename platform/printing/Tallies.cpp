// SPDX-License-Identifier: MIT
#include "platform/printing/Tallies.h"

#include <cmath>
#include <limits>

#include "platform/core/Failure.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace printing {

namespace {

constexpr long double UnitsOfOne = 1e7L;
constexpr int UnitsOfMoney = 1000;  // ten-millionths in its least unit

void requireRange(bool holds) {
    if (!holds) throw core::Failure(core::Overflow, u"O total não cabe num montante."_s);
}

}  // namespace

void Sum::add(const QVariant& value) {
    if (value.typeId() == qMetaTypeId<core::Money>()) {
        units_ += Wide(value.value<core::Money>().units()) * UnitsOfMoney;
    } else if (value.typeId() == QMetaType::Float) {
        // A 32-bit float knows nothing of the seventh decimal: its shortest decimal is meant.
        units_ += Wide(core::Money::fromDouble(core::toDouble(value)).units()) * UnitsOfMoney;
    } else {
        // Engines give a computed column as a double.
        const long double units = std::round(core::toDouble(value) * UnitsOfOne);
        requireRange(std::abs(units) < 1e30L);  // a hundred million rows of these fit
        units_ += static_cast<Wide>(units);
    }
}

core::Money Sum::rounded(int decimals) const {
    Wide step = 1;  // of the last decimal shown
    for (int decimal = decimals; decimal < 7; ++decimal) step *= 10;
    const Wide half = units_ < 0 ? -step / 2 : step / 2;
    const Wide money = (units_ + half) / step * step / UnitsOfMoney;
    requireRange(money <= std::numeric_limits<qint64>::max() &&
                 money >= -std::numeric_limits<qint64>::max());
    return core::Money::fromUnits(static_cast<qint64>(money));
}

size_t Tallies::add(size_t column, bool summed) {
    tallies_.push_back({column, summed, {}, {}});
    return tallies_.size() - 1;
}

void Tallies::startGroup() {
    for (Both& tally : tallies_) tally.group = {};
}

void Tallies::take(const std::vector<QVariant>& row) {
    for (Both& tally : tallies_) {
        const QVariant& value = row[tally.column];
        for (Tally* each : {&tally.report, &tally.group}) {
            ++each->count;
            if (tally.summed && !core::isNull(value)) each->sum.add(value);
        }
    }
}

}  // namespace printing
