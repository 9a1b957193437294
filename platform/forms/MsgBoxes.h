// SPDX-License-Identifier: MIT
#pragma once

namespace forms {

/// Makes core::MsgBox show real message boxes, with Portuguese buttons ("OK", "&Sim", "&Não"), and
/// settles the look of the application (style, colours, locale, icon) and the rule by which a field
/// holds the focus, once. Any screen does it by itself when it is made; a second call does nothing.
/// Without a QApplication it does nothing either.
void install();

}  // namespace forms
