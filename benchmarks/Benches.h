// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

#include "benchmarks/Report.h"

namespace benchmarks {

void measureAccounts(Report& report);
void measureBankFiles(Report& report);
void measureBulk(Report& report);
void measureCoverage(Report& report);
void measureEngines(Report& report);
void measureHospitals(Report& report);
void measureKeys(Report& report);
void measureListings(Report& report);
void measureLists(Report& report);
void measurePrinting(Report& report);
void measureScreens(Report& report);
void measureSearches(Report& report);
void measureWaits(Report& report);
void measureWorkstations(Report& report);

/// What the program is told by when it is started to be waited for: it opens the main window on the
/// book in the settings, and says when its list is painted.
inline const QString UntilListStands = QStringLiteral("--until-list-stands");
int tellWhenListStands();

/// What it is told by when it is started to type into the stand-in for the bank's program: it says
/// the milliseconds of a key and those of a transfer.
inline const QString TypeKeys = QStringLiteral("--type-keys");
int typeKeys();

/// What a process holds in memory now; 0 when it cannot be told.
double residentMegabytes(qint64 process);

}  // namespace benchmarks
