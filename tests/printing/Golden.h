// SPDX-License-Identifier: MIT
#pragma once

#include "platform/printing/Pages.h"

// Whole pages against lists that somebody has looked at. ZELMARS_WRITE_GOLDEN=1 writes the lists
// anew; look at what changed. The suite tells the folder of its lists as GOLDEN_FOLDER.

/// Text, place and style of everything on the pages.
QString describe(const printing::Pages& pages);

/// What the list of that name holds; `shown` is written there first when that is asked for.
QString golden(const QString& name, const QString& shown);
