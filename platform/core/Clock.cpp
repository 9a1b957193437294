// SPDX-License-Identifier: MIT
#include "platform/core/Clock.h"

namespace core {

namespace {
QDate fixedDay;
}

QDate today() {
    return fixedDay.isValid() ? fixedDay : QDate::currentDate();
}

void setToday(QDate day) {
    fixedDay = day;
}

}  // namespace core
