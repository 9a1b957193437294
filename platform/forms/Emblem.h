// SPDX-License-Identifier: MIT
#pragma once

#include <QPixmap>

namespace forms {

/// The system's mark: a cross in a rounded square.
/// @param size  edge in pixels
QPixmap emblem(int size, const QColor& color);

}  // namespace forms
