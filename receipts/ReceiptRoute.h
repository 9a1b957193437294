// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"

/// The ways into the screens of receipts and repositions.
namespace receipts {

/// Open the screen modeless on a new row. Empty texts are replaced by their defaults: the
/// connection "MSAccess" and the query that returns no movement. Fail as opening a row set
/// does.
void openNewReceipt(QString& strConMember, QString& strSQL);
void openNewReposition(QString& strConMember, QString& strSQL);

/// True while a person is at work on a new one.
bool isReceiptUnderWay();
bool isRepositionUnderWay();

/// Show the current row read-only. Not while a new one is under way, which would be lost.
void showReceipt(const ado::RecordsetPtr& rows);
void showReposition(const ado::RecordsetPtr& rows);

}  // namespace receipts
