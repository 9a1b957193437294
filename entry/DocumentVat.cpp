// SPDX-License-Identifier: MIT
#include "entry/DocumentVat.h"

#include "platform/core/Values.h"

namespace entry {

double vatOf(core::Single value, double rate) {
    const double gross = value.toDouble();
    const double vat = gross - gross / (1.0 + rate / 100.0);
    return core::toLong(vat * 100.0) / 100.0;
}

}  // namespace entry
