// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QString>

#include "platform/ado/Recordset.h"

/// The ways into the entry screens and between them. A screen only reports what was chosen; the
/// routes here open the next one.
namespace entry {

/// Opens the entry screen modeless on a new row. Empty texts are replaced by their defaults: the
/// connection "MSAccess" and the query that returns no movement. Fails as opening a row set
/// does.
void openNewMovimento(bool bHospital, QString& strConMember, QString& strSQL);

/// True while the entry screen holds a new row, shown or not.
bool isEntryUnderWay();

/// Gives an existing movement to the entry screen, which stays hidden: an existing movement of any
/// type stays attached there. Not while an entry is under way, which would lose its row.
/// @param Caller  told of an annulment through its member RemoteKey; may be null
void attachMovement(const ado::RecordsetPtr& rows, QObject* Caller);

/// Shows the attached movement, a document or a hospital bill, read-only.
void showMovement(const QString& tipo);

}  // namespace entry
