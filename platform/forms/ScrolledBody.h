// SPDX-License-Identifier: MIT
#pragma once

class QDialog;

namespace forms {

/// Makes a screen that is higher or wider than its display fit: its frames scroll, its heading band
/// and what stands beside the frames, such as the row of buttons, stay in sight, and so does the
/// field with the focus. A screen that fits is left as it is. For screens about to be shown.
void fitToDisplay(QDialog& screen);

}  // namespace forms
