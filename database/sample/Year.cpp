// SPDX-License-Identifier: MIT
#include "database/sample/Year.h"

#include <algorithm>
#include <numeric>

namespace database::sample {

QDate Calendar::day(qint64 place, qint64 total) const {
    const QDate first = opening();
    const qint64 days = first.daysTo(last_) + 1;
    QDate day = first.addDays(place * days / std::max<qint64>(total, 1));
    if (day.dayOfWeek() == Qt::Saturday) day = day.addDays(-1);
    if (day.dayOfWeek() == Qt::Sunday) day = day.addDays(day < last_ ? 1 : -2);
    return std::clamp(day, first, last_);
}

Places::Places(qint64 total, int households)
    : total_(total), stride_(std::max<qint64>(1, total * 618 / 1000)), households_(households) {
    while (std::gcd(stride_, total_) > 1) ++stride_;
}

std::vector<qint64> Places::next(Random& random) {
    if (households_ == 0 || dealt_ == total_) return {};
    // Between none and twice the mean of what is left, in thousandths.
    const qint64 left = total_ - dealt_;
    const qint64 share = 2 * left * random.below(1001) / households_;
    qint64 count = share / 1000 + (random.below(1000) < share % 1000 ? 1 : 0);
    count = --households_ == 0 ? left : std::min(count, left);
    // The stride has no divisor in common with the total, so no place is dealt twice.
    std::vector<qint64> places;
    for (qint64 at = 0; at < count; ++at) places.push_back((dealt_ + at) * stride_ % total_);
    dealt_ += count;
    std::sort(places.begin(), places.end());
    return places;
}

}  // namespace database::sample
