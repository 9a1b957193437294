// SPDX-License-Identifier: MIT
#pragma once

#include "platform/printing/Report.h"

/// The two printed lists of what is paid, bound to the row sets of their names.
namespace reports {

/// A line for each member and number of cheque.
printing::Report Print_frmTRF_CHQ();

/// A line for each member who is paid by transfer.
printing::Report Print_frmTRF_TRF();

}  // namespace reports
