// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "platform/ado/Recordset.h"

/// What every annulment does, whatever the type of the movement.
namespace data {

/// The tables in which a movement and its accumulators live.
struct Twins {
    QString movements;
    QString accumulators;
};

/// Those of the active members, or of the members who have left, by `ficheiro` of the movement
/// shown.
Twins twinsOf(const ado::Recordset& shown);

/// Asks whether to annul.
bool confirmAnnulment(const QString& title);

/// Marks the movement shown as annulled and writes its correcting row, with a number of its own,
/// into the same table: three writes (mark, counter, correcting row) in that order. Neither a
/// second annulment nor a movement that has vanished stops it; the latter is told.
/// @param shown    the movement as the screen has it; the correcting row takes its values from here
/// @param setRest  sets the columns of the correcting row beyond day, type, member and number
void annul(const ado::Recordset& shown, const QString& caption,
           const std::function<void(ado::Recordset& correcting)>& setRest);

}  // namespace data
