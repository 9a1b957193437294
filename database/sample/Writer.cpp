// SPDX-License-Identifier: MIT
#include "database/sample/Writer.h"

namespace database::sample {

Value dayValue(QDate day) {
    if (!day.isValid()) return Null;
    return day.toString(Qt::ISODate).toLatin1() + " 00:00:00";
}

}  // namespace database::sample
