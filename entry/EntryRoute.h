// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QString>
#include <QVariant>

/// The ways into the entry screens and between them. A screen only reports what was chosen; the
/// routes here open the next one.
namespace entry {

/// Opens the entry screen modeless on a new row. Empty texts are replaced by their defaults: the
/// connection "MSAccess" and the statement that returns no movement. Fails as opening a row set
/// does.
void openNewMovimento(bool bHospital, QString& strConMember, QString& strSQL);

/// Opens the movement whose key is `Pkey` read-only, in the screen of its type. A movement that is
/// not in force, or of a type without a screen, opens nothing. `Caller` (or null) is told of an
/// annulment through its member RemoteKey.
void openRegisto(const QVariant& Pkey, QObject* Caller);

}  // namespace entry
