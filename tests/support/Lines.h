// SPDX-License-Identifier: MIT
#pragma once

#include <QFile>
#include <QStringList>
#include <stdexcept>

namespace support {

/// The lines of a list that a test walks through, without blanks around them. A list that is
/// missing ends the run.
inline QStringList linesOf(const QString& path) {
    QStringList lines;
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) throw std::runtime_error(path.toStdString());
    while (!file.atEnd()) lines << QString::fromUtf8(file.readLine()).trimmed();
    return lines;
}

}  // namespace support
