// SPDX-License-Identifier: MIT
#pragma once

#include "data/Operations.h"

namespace receipts {

/// A reposition that is to be posted: a member's account put right by hand. The texts are looked at
/// for emptiness only, the person's code also for its value.
struct Reposition {
    ado::RecordsetPtr record = {};  ///< its current row is the pending movement
    qint32 socio_id = 0;            ///< the member; 0 for none
    QString caption = {};           ///< the screen's; title of the boxes
    QString rubric = {};            ///< as shown
    QString personCode = {};
    QString memberNumber = {};
    QString debit = {};
    QString credit = {};
};

/// Accumulators of member, rubric and person; rubric 0 where none was chosen (null). Intentional:
/// the comparison with Null holds for no row, so that every reposition without a rubric adds one.
/// @param table  that of the active members, or of those who have left
QString accumulatorQuery(const QString& table, qint32 socio_id, const QVariant& rubrica_id,
                         const QString& codABC);

/// Asks, checks, draws the number, saves the row and adds to the accumulator of member, rubric and
/// person. True when all of it is done; false when it was refused or something is missing (the
/// operator was told) and the screen stays.
/// @param operation  of this screen from its first press of "&OK" to its last: on a reposition that
/// an earlier press registered only what is missing is done, and nothing is asked
bool postReposition(const Reposition& reposition, data::Operation& operation);

const data::MovementRules& repositionRules();

}  // namespace receipts
