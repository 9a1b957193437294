// SPDX-License-Identifier: MIT
#pragma once

#include <QStringList>

namespace automation {

/// The program and its arguments that the first of the files programs.ini with a line for a path
/// names: the user's own (~/.config/zelmars), then the machine's (/etc/zelmars). A line is
///
///     C:\Dir\program.exe = /opt/dir/program argument "another argument"
///
/// Upper and lower case in the path are one; lines that begin with # or ; say nothing. Nothing in a
/// line is expanded. Fails with a text that names the file when there is no line, or when its
/// program is none.
QStringList programFor(const QString& path);

/// The user's own file, which may not be there.
QString programsFile();

}  // namespace automation
