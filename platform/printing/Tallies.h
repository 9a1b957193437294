// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>
#include <vector>

#include "platform/core/Money.h"

namespace printing {

/// A sum of amounts, exact to the seventh decimal: an amount of four times a rate of three.
class Sum {
public:
    /// Fails with TypeMismatch on what is no number, with Overflow past all sense.
    void add(const QVariant& value);
    /// To so many decimals, at most four, halves away from zero. Fails with Overflow past the range
    /// of money.
    core::Money rounded(int decimals) const;

private:
    __extension__ using Wide = __int128;
    Wide units_ = 0;  ///< ten-millionths
};

/// Figures over the rows of a report and of the group being printed.
class Tallies {
public:
    /// What a total of either kind shows.
    struct Tally {
        Sum sum;  ///< nulls are passed over
        qint64 count = 0;
    };

    /// A tally of a column of the detail rows; its place among the tallies. Only what is to be
    /// summed is read as a number.
    size_t add(size_t column, bool summed);
    /// Sets the figures of the group to nothing.
    void startGroup();
    /// Takes a row in. Fails as adding to a sum does.
    void take(const std::vector<QVariant>& row);

    // The figures so far of the tally at that place.
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

}  // namespace printing
