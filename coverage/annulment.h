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
/// caller back. True when the screen may go; false when the operator said no.
///
/// Mark, counter, correcting row and accumulator are four writes with no transaction around them. A
/// failure of the first three goes up, and annulling again completes them; one of the last is told,
/// and nobody is called back.
bool annul(const Annulment& annulment);

}  // namespace coverage
