// SPDX-License-Identifier: MIT
#pragma once

#include <QSize>
#include <QTemporaryFile>

namespace tour {

/// Without a screen the toolkit pretends a display that is smaller than any office's. While this
/// lives there is one of the size given, in pixels of 96 to the inch. Made before the application
/// object, which reads the description.
class Display {
public:
    explicit Display(QSize size);

private:
    QTemporaryFile description_;
};

/// What a person has set the desktop to. Called between the application object and its first
/// window.
/// @param percent  size of the letters, 100 as they usually are
/// @param dark     light letters on a dark ground
void setDesktop(int percent, bool dark);

}  // namespace tour
