// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"
#include "platform/printing/DataReport.h"

/// The two printed extracts of a member's movements. Both are bound to `Print_Extrato1`; the
/// captions `nib`, `no_kor`, `nome`, `morada`, `localidade` of their section `Section4` are the
/// member's and set before printing.
///
/// Here `debito` is what the plan pays the member, and `credito` what he owes or paid in.
namespace reports {

/// Detailed: a framed block for each medical document.
printing::Report prtExtrato1();

/// Summary: a line for each movement, their titles once, at the head of the report.
printing::Report rptExtrato2();

/// One of the two with the captions of a member, the current row of the set.
printing::DataReport extractOf(const ado::Recordset& member, bool detailed);

}  // namespace reports
