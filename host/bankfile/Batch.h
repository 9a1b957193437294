// SPDX-License-Identifier: MIT
#pragma once

#include "host/bankfile/TransferRows.h"

namespace bankfile {

/// A line that goes to the bank.
struct Payment {
    TransferRow row;
    core::Money amount;  ///< of the row, to the nearest cent as the printed list shows it
    QString iban;
    QString name;         ///< as the bank takes it
    QString reference;    ///< from end to end; names the movements, unique in its file
    QString explanation;  ///< what the member reads in the account

    friend bool operator==(const Payment&, const Payment&) = default;
};

/// A line that cannot go.
struct Refused {
    TransferRow row;
    QString why;  ///< in Portuguese, for people

    friend bool operator==(const Refused&, const Refused&) = default;
};

/// The lines of the list, parted in those that go and those that cannot.
struct Batch {
    std::vector<Payment> payments;
    std::vector<Refused> refused;

    core::Money sum() const;
    core::Money refusedSum() const;

    friend bool operator==(const Batch&, const Batch&) = default;
};

Batch batchOf(std::vector<TransferRow> rows);

/// What rounding to cents comes to, to stand behind the sum of the payments; empty where it is
/// nothing.
QString shownRounding(const std::vector<Payment>& payments);

/// An amount for people, with all of its decimals where it has more than two.
QString shownAmount(core::Money amount);

/// Names the movements: "M7501-7502-7503", or, when those are too many, the first ones and how many
/// more there are: "M7501-7502+12". At most `most` characters.
QString referenceOf(const std::vector<qint64>& numbers, qsizetype most);

}  // namespace bankfile
