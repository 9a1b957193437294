// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QPointer>

#include "data/Operations.h"

namespace coverage {

/// The document or hospital bill to be annulled, as the screen shows it.
struct Annulment {
    ado::RecordsetPtr shown;               ///< its current row is the movement, with `ficheiro`
    QString caption;                       ///< the screen's
    QPointer<QObject> CallbackClass = {};  ///< told of the movement through RemoteKey; may be null
};

/// Asks, marks the movement, writes its correcting row, takes the accumulators back and calls the
/// caller back. True when the screen may go, also when somebody else had annulled the movement;
/// false when the operator said no or something is missing, which he was told.
///
/// Mark, counter, correcting row and accumulator are four writes with no transaction around them. A
/// failure of the first goes up.
/// @param operation  of this screen from its first press of "Anular" to its last: what an earlier
/// press did is not done again
bool annul(const Annulment& annulment, data::Operation& operation);

}  // namespace coverage
