// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QVariant>

namespace boundary {

/// The query of one row: a movement that is in force, with the member and the names that the
/// screens show.
QString movementInForceQuery(const QVariant& Pkey);

/// Opens the movement whose key is `Pkey` read-only, in the screen of its type. A movement that is
/// not in force, or of a type without a screen, opens nothing. Fails while something is being typed
/// that the view would take away.
/// @param Caller  told of an annulment on the entry screen through its member RemoteKey; may be
/// null
void openRegisto(const QVariant& Pkey, QObject* Caller);

}  // namespace boundary
