// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace host {

/// Plays the road of one document on a sample book of its own through the real screens, leaves a
/// picture of each in the folder and says on the standard output what it did. Gives an exit code.
int playTour(const QString& folder);

}  // namespace host
