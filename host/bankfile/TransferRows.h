// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <QString>
#include <compare>
#include <optional>
#include <vector>

#include "platform/core/Money.h"

namespace bankfile {

/// A movement of the year's accounts. Its number begins anew each year, its key does not.
struct MovementKey {
    bool left = false;  ///< in the table of members who have left
    qint64 movimento_id = 0;

    friend auto operator<=>(const MovementKey&, const MovementKey&) = default;
};

/// One line of the list of transfers, and what it is made of.
struct TransferRow {
    QString staffNumber = {};
    QString name = {};
    QString nib = {};  ///< as it stands in the book
    core::Money amount = {};
    std::vector<MovementKey> movements = {};
    std::vector<qint64> numbers = {};  ///< of those movements that have one, in the same order

    friend bool operator==(const TransferRow&, const TransferRow&) = default;
};

/// Exactly the lines of the list of transfers between two days, in its order. `connection` is a
/// connection string. Fails as the engine does, and when the book is being changed meanwhile so
/// that the movements never come to the sums of the list.
std::vector<TransferRow> readTransferRows(const QString& connection, const QDate& first,
                                          const QDate& last);

}  // namespace bankfile
