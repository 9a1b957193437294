// SPDX-License-Identifier: MIT
#pragma once

#include "data/Operations.h"

namespace receipts {

/// A receipt that is to be posted. The texts are looked at for emptiness only.
struct Receipt {
    ado::RecordsetPtr record = {};  ///< its current row is the pending movement
    qint32 socio_id = 0;            ///< the member; 0 for none
    QString caption = {};           ///< the screen's; title of the boxes
    QString paymentMode = {};
    QString memberNumber = {};
    QString credit = {};
};

// Queries. `table` is that of the active members, or of those who have left.
/// The account-level accumulator of a member, to which receipts are added.
QString accountQuery(const QString& table, qint32 socio_id);
/// All accumulators of a member.
QString accumulatorsQuery(const QString& table, const QVariant& socio_id);

/// Asks, checks, draws the number, saves the row and adds to the member's account-level
/// accumulator. True when all of it is done; false when it was refused or something is missing (the
/// operator was told) and the screen stays.
///
/// Counter, movement and accumulator are three writes with no transaction around them. A failure of
/// the first two goes up, and a number drawn is lost.
/// @param operation  of this screen from its first press of "&OK" to its last: on a receipt that an
/// earlier press registered only what is missing is done, and nothing is asked
bool postReceipt(const Receipt& receipt, data::Operation& operation);

/// Asks, marks the receipt, writes its correcting row and takes the amount back from an
/// accumulator. True when the screen may go, also when somebody else had annulled it; false when
/// the operator said no or something is missing, which he was told.
///
/// Mark, counter, correcting row and accumulator are four writes; a failure of the first goes up.
/// @param shown  its current row is the receipt, with `ficheiro`
/// @param operation  of this screen, as above
bool annulReceipt(const ado::RecordsetPtr& shown, const QString& caption,
                  data::Operation& operation);

const data::MovementRules& receiptRules();

}  // namespace receipts
