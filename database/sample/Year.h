// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "database/sample/Account.h"
#include "database/sample/Random.h"

namespace database::sample {

/// The working days from the second of January to a last day, over which movements are spread.
class Calendar {
public:
    Calendar(int year, QDate last) : first_(year, 1, 1), last_(last) {}
    /// The day of opening balances.
    QDate opening() const { return std::min(first_.addDays(1), last_); }
    /// The day of the n-th of `total` places, never a weekend unless there is no other day.
    QDate day(qint64 place, qint64 total) const;

private:
    QDate first_;
    QDate last_;
};

/// Deals the places of a year's movements out to the households, so that each household's lie all
/// over the year, numbers run with the days, and nothing needs to be remembered.
class Places {
public:
    Places(qint64 total, int households);
    /// The places of the next household in ascending order, counted from 0.
    std::vector<qint64> next(Random& random);

private:
    qint64 total_;
    qint64 stride_;
    qint64 dealt_ = 0;
    qint64 households_;
};

}  // namespace database::sample
