// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QWidget>
#include <functional>

namespace tour {

/// Plays the road of one document and of one hospital bill through the real screens, on a sample
/// book of its own that goes afterwards, and leaves a picture of each screen in the folder.
/// @param look  gets each screen as it stands when its step begins; may be empty
/// @return false when a screen did not come. Fails with a core::Failure when the folder cannot be
/// made.
bool play(const QString& folder, const std::function<void(QWidget*)>& look = {});

}  // namespace tour
