// SPDX-License-Identifier: MIT
#pragma once

#include <QFileDevice>

/// What this system writes is about people's health: it belongs to whoever wrote it, whatever the
/// umask says.
namespace core {

/// The mode of such a file: read and written by its owner, closed to everybody else.
inline constexpr QFileDevice::Permissions OwnerOnly =
    QFileDevice::ReadOwner | QFileDevice::WriteOwner;

/// True when nobody but the owner has any right to the file, except for those named.
bool isPrivate(const QString& file, QFileDevice::Permissions except = {});

/// Makes a folder that only its owner enters, and the folders above it that are missing likewise.
/// One that is there already keeps its mode. False when it cannot be made.
bool makePrivateFolder(const QString& folder);

}  // namespace core
