// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>

#include "platform/ado/Recordset.h"

namespace receipts {

/// What the screen of a new reposition hands over: a correction of an account, typed by hand. The
/// texts are looked at for emptiness only, `Text3` also for its value.
struct RepositionEntry {
    ado::RecordsetPtr record;  ///< its current row is the pending movement
    qint32 Socio_ID = 0;       ///< the member; 0 for none
    QString caption;           ///< the screen's; title of the boxes
    QString DataCombo1;        ///< the rubric as shown
    QVariant rubrica_id;       ///< the rubric chosen; null for none
    QString Text3;             ///< code of the person
    QString No_Kor;            ///< the member's number
    QString Debito;
    QString Credito;
};

/// Asks, checks, draws the number, saves the row and adds to the accumulator of member, rubric and
/// person. True when it was posted; false when it was refused or could not be saved (the operator
/// was told) and the screen stays. A failure with the accumulator is passed over without a word.
bool postReposition(const RepositionEntry& reposition);

}  // namespace receipts
