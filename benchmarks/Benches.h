// SPDX-License-Identifier: MIT
#pragma once

#include "benchmarks/Report.h"

namespace benchmarks {

void measureAccounts(Report& report);
void measureCoverage(Report& report);
void measureEngines(Report& report);
void measureLists(Report& report);
void measurePrinting(Report& report);
void measureScreens(Report& report);
void measureSearches(Report& report);
void measureWorkstations(Report& report);

/// What a process holds in memory now; 0 when it cannot be told.
double residentMegabytes(qint64 process);

}  // namespace benchmarks
