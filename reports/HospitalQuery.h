// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>
#include <QString>

namespace reports {

/// The query behind the listing of hospitals, in two levels: a row is a hospital that sent a bill
/// ("HOS") in the period, its name null where the table of hospitals does not know it; under it
/// stand all movements of the period that name it, of whatever kind, in order of movimento_id.
/// Members and those who have left are read together; closed years are not.
///
/// Intentional: the last day counts as its midnight, so that movements with a later time of that
/// day are left out.
QString hospitalListQuery(const QDate& first, const QDate& last);

}  // namespace reports
