// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace com {

/// A component does whatever its shared object says, with the rights of the person at the screen.
/// Fails with CannotCreateObject, and a text that names the place and the command that mends it,
/// when somebody else can change the file or put another one in its place: the file, or a folder on
/// its way, may be written by others, or belongs to somebody other than the administrator or the
/// user. The owner of a folder on the way of the running program is trusted, as he could change the
/// program itself. A folder in which everybody can only change what is his own (as that for
/// temporary files) is no danger.
/// @param file  an existing file, without links on its way
void refuseOpenPlace(const QString& file);

/// The folder of the shared object, or program, that a function belongs to.
QString folderOf(const void* function);

}  // namespace com
