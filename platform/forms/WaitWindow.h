// SPDX-License-Identifier: MIT
#pragma once

namespace forms {

/// Makes long waits show a small window ("frmEspera") that says what is waited for and lets the
/// operator give up; all other windows go on being painted meanwhile and take no input.
void installWaitWindow();

}  // namespace forms
