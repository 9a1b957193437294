// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"

/// What every new movement goes through, whatever its type.
namespace data {

/// The empty row set to which a screen adds its new row. Empty texts receive their defaults: the
/// connection "MSAccess" and the statement that returns no movement. Fails as opening does.
ado::RecordsetPtr openNewMovement(QString& strConMember, QString& strSQL);

/// Asks whether to finish the entry.
bool confirmPosting(const QString& caption);

/// Readies a movement that has no document for being saved: it is the member's, its document's
/// value is 0, and no failure is pending.
void readyWithoutDocument(ado::Recordset& movement, qint32 socio_id);

/// Draws the movement's number and saves the pending row: two writes, the counter first. A row
/// whose number cannot be drawn is not saved.
void numberAndSave(ado::Recordset& movement);

/// True when no failure is pending. Otherwise shows its text, then says that nothing could be
/// registered.
bool savedOrTold(const QString& caption);

}  // namespace data
