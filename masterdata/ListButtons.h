// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Bound.h"
#include "platform/forms/Controls.h"
#include "platform/forms/DataGrid.h"

class QLayout;

namespace masterdata {

/// The buttons of a list and its grid below each other. Enter or a double click in the grid does
/// what `change` does.
struct ListButtons {
    forms::Button* add;
    forms::Button* change;
    forms::Button* remove;
    forms::Button* leave;
};
QLayout* listWithButtons(forms::DataGrid* grid, const ListButtons& buttons);

/// The key of the row that a list stands on. Fails when there is none.
qint32 keyOf(const forms::DataControl& list, const QString& column);

}  // namespace masterdata
