// SPDX-License-Identifier: MIT
#pragma once

#include "platform/printing/Report.h"

namespace reports {

/// The listing of hospitals in two levels, bound to the row set of its name: a group for each
/// hospital, in it a line for each movement, under it their sums.
printing::Report Print_frmListagemHospitais();

}  // namespace reports
