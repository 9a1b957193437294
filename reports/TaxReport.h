// SPDX-License-Identifier: MIT
#pragma once

#include "platform/printing/Report.h"

namespace reports {

/// The declaration of what a member paid himself in a year, for his income tax: a page for each row
/// of taxQuery().
printing::Report prtIRS();

}  // namespace reports
