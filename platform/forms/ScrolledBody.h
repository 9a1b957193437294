// SPDX-License-Identifier: MIT
#pragma once

class QDialog;

namespace forms {

/// Makes a screen that is higher or wider than its display fit: its frames and tables scroll, its
/// heading band and what stands beside the frames, such as the row of buttons, stay in sight, and
/// so does the field with the focus, with its label, and the part that the screen keeps in sight
/// when something new stands there. A screen that only asks for more room than there is gets what
/// there is; one that fits is left as it is. For screens about to be shown.
void fitToDisplay(QDialog& screen);

}  // namespace forms
