// SPDX-License-Identifier: MIT
#include "database/BookWriter.h"

namespace database {

QByteArray Table::columnList() const {
    QByteArray list;
    for (const QByteArray& column : columns) list += (list.isEmpty() ? "" : ", ") + column;
    return list;
}

Value dayValue(QDate day) {
    if (!day.isValid()) return Null;
    return day.toString(Qt::ISODate).toLatin1() + " 00:00:00";
}

}  // namespace database
