// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>
#include <vector>

#include "platform/core/Money.h"

namespace reports {

/// Exact figures over the rows of a report and of the group being printed.
class Tallies {
public:
    struct Tally {
        core::Money sum;
        qint64 count = 0;
    };

    /// A tally of a column of the detail rows; its place among the tallies. Only what is to be
    /// summed is read as a number.
    size_t add(size_t column, bool summed);
    void startGroup();
    /// Takes a row in. Fails with TypeMismatch on a sum over what is no number, with Overflow past
    /// the range of money.
    void take(const std::vector<QVariant>& row);

    const Tally& ofReport(size_t place) const { return tallies_[place].report; }
    const Tally& ofGroup(size_t place) const { return tallies_[place].group; }

private:
    struct Both {
        size_t column;
        bool summed;
        Tally report;
        Tally group;
    };
    std::vector<Both> tallies_;
};

}  // namespace reports
