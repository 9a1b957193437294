// SPDX-License-Identifier: MIT
#include "platform/reports/Tallies.h"

#include "platform/core/Values.h"

namespace reports {

namespace {

/// Engines give a computed column as a double; four decimals of it are what was meant.
core::Money toMoney(const QVariant& value) {
    if (value.typeId() == qMetaTypeId<core::Money>()) return value.value<core::Money>();
    return core::Money::fromDouble(core::toDouble(value));
}

}  // namespace

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
        if (core::isNull(value)) continue;
        const core::Money amount = tally.summed ? toMoney(value) : core::Money();
        for (Tally* each : {&tally.report, &tally.group}) {
            each->sum = each->sum + amount;
            ++each->count;
        }
    }
}

}  // namespace reports
