// SPDX-License-Identifier: MIT
#pragma once

#include <QSettings>
#include <QStandardPaths>

namespace host {

/// What the windows remember of how their user left them: places, columns, choices. Lost settings
/// cost a look, and nothing of a book.
class WindowSettings : public QSettings {
public:
    WindowSettings()
        : QSettings(QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) +
                        QStringLiteral("/zelmars/janela.ini"),
                    QSettings::IniFormat) {}
};

}  // namespace host
