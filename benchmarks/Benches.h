// SPDX-License-Identifier: MIT
#pragma once

#include "benchmarks/Report.h"

namespace benchmarks {

void measureAccounts(Report& report);
void measureCoverage(Report& report);
void measureEngines(Report& report);
void measureScreens(Report& report);
void measureSearches(Report& report);
void measureWorkstations(Report& report);

}  // namespace benchmarks
