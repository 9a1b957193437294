// SPDX-License-Identifier: MIT
#pragma once

namespace boundary {

/// Reads the five values of the configuration, reopens both connections with them and the six lists
/// that the screens choose from.
/// @return false when a value is missing, with the connections untouched, or when a failure was
/// pending beforehand, with the connections open. Fails as a connection or a list that cannot be
/// opened does; with a list the login itself counts.
bool Login();

}  // namespace boundary
