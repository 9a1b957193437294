// SPDX-License-Identifier: MIT
#pragma once

#include <QObject>
#include <QPointer>

#include "platform/ado/Recordset.h"

namespace coverage {

/// The document or hospital bill to be annulled, as the screen shows it.
struct Annulment {
    ado::RecordsetPtr shown;               ///< its current row is the movement, with `ficheiro`
    QString caption;                       ///< the screen's
    QPointer<QObject> CallbackClass = {};  ///< told of the movement through RemoteKey; may be null
};

/// Asks, marks the movement, writes its correcting row, takes the accumulators back and calls the
/// caller back. True when it was done and the screen may go; false when the operator said no.
///
/// Mark, counter, correcting row and accumulator are four writes with no transaction around them. A
/// failing one goes up, and what was written before it stays.
bool annul(const Annulment& annulment);

}  // namespace coverage
