// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"

namespace receipts {

/// What the screen of a new receipt hands over. The texts are looked at for emptiness only.
struct ReceiptEntry {
    ado::RecordsetPtr record;  ///< its current row is the pending movement
    qint32 Socio_ID = 0;       ///< the member; 0 for none
    QString caption;           ///< the screen's; title of the boxes
    QString DataCombo3;        ///< mode of payment
    QString No_Kor;            ///< the member's number
    QString Credito;           ///< the amount
};

/// Asks, checks, draws the number, saves the row and adds to the member's account-level
/// accumulator. True when it was posted; false when it was refused (the operator was told) and the
/// screen stays.
///
/// Counter, movement and accumulator are three writes with no transaction around them. A failure of
/// the first two goes up, and a number drawn is lost; one of the last is told, and counts as
/// posted.
bool postReceipt(const ReceiptEntry& receipt);

/// Asks, marks the receipt, writes its correcting row and takes the amount back from an
/// accumulator. True when the screen may go; false when the operator said no.
///
/// Mark, counter, correcting row and accumulator are four writes, as above: a failure of the first
/// three goes up, and annulling again completes them.
/// @param shown  its current row is the receipt, with `ficheiro`
bool annulReceipt(const ado::RecordsetPtr& shown, const QString& caption);

}  // namespace receipts
