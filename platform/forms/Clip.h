// SPDX-License-Identifier: MIT
#pragma once

#include <QImage>
#include <QString>
#include <vector>

namespace forms {

/// The pictures of a short silent film, as an uncompressed AVI file keeps them: one RIFF file with
/// one video stream, each picture a device-independent bitmap of 24 or 32 bits a point, of the
/// latter the fourth byte tells how opaque the point is.
struct Clip {
    std::vector<QImage> pictures;  ///< all of one size; never empty
    int millisecondsPerPicture = 100;

    /// Fails with a text that names the file when it is missing, is no such film, or is larger than
    /// a clip of a screen has any reason to be.
    static Clip read(const QString& file);
};

}  // namespace forms
