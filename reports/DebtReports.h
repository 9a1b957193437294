// SPDX-License-Identifier: MIT
#pragma once

#include "platform/printing/Report.h"

/// Who owes the organisation what the plan did not pay. Both reports show the rows of the data
/// environment's command Print_frmListagemDividas, so that list and letters agree.
namespace reports {

/// A line for each debtor.
printing::Report Print_frmListagemDividas();

/// A letter for each debtor. The address stands where the window of a DL or C5 envelope is (20 to
/// 90 mm from the left, 45 to 80 mm from the top), and marks at the left edge show where to fold:
/// at 105 and 210 mm for DL, at 148.5 mm for C5.
printing::Report Print_frmCartasDividas();

}  // namespace reports
