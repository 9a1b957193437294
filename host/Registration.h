// SPDX-License-Identifier: MIT
#pragma once

namespace host {

/// Registers the component and its companions that lie beside the program, or withdraws them. Fails
/// with a text that names the first that could not be.
void registerComponents(bool undo);

/// Registers them unless all of them are there already, those of another installation included.
/// Why it could not be done goes to the standard error stream; the operation that needs them then
/// says what it lacks.
void registerMissing();

}  // namespace host
