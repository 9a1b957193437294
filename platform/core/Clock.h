// SPDX-License-Identifier: MIT
#pragma once

#include <QDate>

namespace core {

/// Today, in the machine's zone. The one place where the system asks for the date.
QDate today();

/// For tests and reproducible figures: the day that today() gives; an invalid date returns to the
/// machine's clock.
void setToday(QDate day);

}  // namespace core
