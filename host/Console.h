// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QTextStream>

namespace host {

/// A line on the standard output.
inline void say(const QString& text) {
    QTextStream(stdout) << text << Qt::endl;
}

/// A line on the standard error stream.
inline void complain(const QString& text) {
    QTextStream(stderr) << text << Qt::endl;
}

}  // namespace host
