// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

/// A member's premium, the quotas of the health plan.
namespace data {

/// One row: a member's premium.
QString premiumQuery(qint32 socio_id);

/// What is to be said of a member's premium; empty when it is paid up.
QString premiumWarning(qint32 socio_id);

}  // namespace data
