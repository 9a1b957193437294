// SPDX-License-Identifier: MIT
#pragma once

namespace forms {

/// Makes core::MsgBox show real message boxes, with Portuguese buttons ("OK", "&Sim", "&Não"), and
/// settles the look of the application (style, locale) once. Any screen does it by itself when it
/// is made; a second call does nothing.
void install();

}  // namespace forms
