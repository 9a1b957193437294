// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace host {

/// Plays the road of one document and of one hospital bill through the real screens, on a sample
/// book of its own that goes afterwards, and leaves a picture of each screen in the folder. Gives
/// an exit code; fails when the folder cannot be made.
int playTour(const QString& folder);

}  // namespace host
