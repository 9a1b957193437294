// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>
#include <optional>

/// Small files of lines `key = value` that a user or an administrator writes by hand.
namespace core {

/// Where a file of that name is looked for, the first place first: the user's own
/// ($XDG_CONFIG_HOME/zelmars, that is ~/.config/zelmars), then the machine's (/etc/zelmars).
/// Neither need be there.
QStringList configurationFiles(const QString& name);

/// What the first line for a key in a file says, without the blanks around it; nothing when there
/// is no such line, or the file cannot be read. Upper and lower case in a key are one; a line that
/// begins with # or ; says nothing. The file is UTF-8.
std::optional<QString> lineFor(const QString& key, const QString& file);

}  // namespace core
