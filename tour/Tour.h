// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace tour {

/// Plays the road of one document and of one hospital bill through the real screens, on a sample
/// book of its own that goes afterwards, and leaves a picture of each screen in the folder.
/// @return false when a screen did not come. Fails with a core::Failure when the folder cannot be
/// made.
bool play(const QString& folder);

}  // namespace tour
