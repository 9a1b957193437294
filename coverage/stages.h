// SPDX-License-Identifier: MIT
#pragma once

#include "coverage/Progress.h"
#include "coverage/TryOut.h"

/// The stages of a try-out, in the order in which a document passes through them, and of its
/// annulment.
namespace coverage {

/// Working values that the first stage leaves to the later ones; 32-bit floats, as the whole
/// calculation is.
struct Working {
    ado::RecordsetPtr rubric;  ///< the rubric's row, open until the ceilings are done
    float limit = 0;           ///< the rubric's yearly limit of this person; a missing one is 0
    float franquia = 0;        ///< the rubric's franchise; a missing one is 0
};

/// True when the entry is for the member himself, and not for a relative.
bool isMember(const Entry& entry);

/// Writes what is left of all ceilings into `saldo_plafond`. False when the number of documents is
/// used up: the box was shown and the try-out ends.
bool applyCeilings(const Entry& entry, const Working& working, Progress& progress, TryOut& run);

/// Writes balance, gross, net, credit and debit.
void setAmounts(const Entry& entry, const Working& working, Progress& progress, TryOut& run);

/// Sets what the correcting row of an annulled document keeps of it.
void setCorrection(const ado::Recordset& shown, ado::Recordset& correcting);
/// Takes an annulled document back from its accumulators.
void takeBack(const ado::Recordset& shown, const ado::Accompaniment& with);

}  // namespace coverage
