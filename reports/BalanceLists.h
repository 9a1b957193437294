// SPDX-License-Identifier: MIT
#pragma once

#include "platform/printing/Report.h"

/// The balances that members have before the close of a year: no movement is carried over but for
/// debts above 0.1.
namespace reports {

/// Rows `no_kor`, `nome`, `saldo` (debits less credits), one for each member and table, by number.
/// A null amount counts as 0, as the close counts it.
QString carriedDebtsQuery();
QString vanishingBalancesQuery();

/// The list of such rows.
printing::Report balanceList(const QString& caption);

}  // namespace reports
