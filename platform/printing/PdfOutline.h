// SPDX-License-Identifier: MIT
#pragma once

#include <QFileDevice>

#include "platform/printing/Pages.h"

namespace printing {

/// Adds what QPdfWriter cannot write to the file that it has just written, which is open for
/// writing: the language, Portuguese, and the bookmarks of the pages `from`..`to`, counted from 0,
/// which are those of the file. The file grows by them and is otherwise left as it is. Fails when
/// it is not as that writer makes it; what the device does not take, it tells itself.
void addOutline(QFileDevice& file, const Pages& pages, int from, int to);

}  // namespace printing
