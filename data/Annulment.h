// SPDX-License-Identifier: MIT
#pragma once

#include "data/Operations.h"

/// What every annulment does, whatever the type of the movement.
namespace data {

/// The tables in which a movement and its accumulators live.
struct Twins {
    QString movements;
    QString accumulators;
};

/// Those of the active members, or of the members who have left, by `ficheiro` of the movement
/// shown; a row without that column is a new one of an active member.
Twins twinsOf(const ado::Recordset& shown);

/// One row: a movement of one of the tables.
QString movementQuery(const QString& table, const QVariant& movimento_id);

/// Asks whether to annul.
bool confirmAnnulment(const QString& title);

/// What an annulment came to.
enum class Annulled {
    Corrected,  ///< marked and corrected; the accumulators come next
    Elsewhere,  ///< somebody else had annulled it: nothing was written, and the operator was told
                ///< by whom
    Unfinished  ///< marked, but not corrected; the operator was told and the screen has to stay
};

/// Marks the movement shown as annulled and writes its correcting row, with a number of its own,
/// into the same table: three writes (mark, counter, correcting row) in that order. The movement is
/// looked at afresh, and held, before it is marked. One that has vanished is told and corrected all
/// the same. What `annulment` has done before is not done again. A failure before anything is
/// registered goes up.
/// @param shown  the movement as the screen has it; the correcting row takes its values from here
Annulled annul(const ado::Recordset& shown, const QString& caption, const MovementRules& rules,
               Operation& annulment);

/// Writes the correcting row of a movement that is marked. Fails with NotAccompanied, and writes
/// nothing, when somebody else did it meanwhile.
void addCorrectingRow(const ado::Recordset& shown, const MovementRules& rules,
                      Operation& annulment);

}  // namespace data
