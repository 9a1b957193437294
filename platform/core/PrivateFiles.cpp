// SPDX-License-Identifier: MIT
#include "platform/core/PrivateFiles.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

namespace core {

bool isPrivate(const QString& file, QFileDevice::Permissions except) {
    constexpr QFile::Permissions others = QFile::ReadGroup | QFile::WriteGroup | QFile::ExeGroup |
                                          QFile::ReadOther | QFile::WriteOther | QFile::ExeOther;
    return !(QFile::permissions(file) & others & ~except);
}

bool makePrivateFolder(const QString& folder) {
    const QFileInfo wanted(QDir::cleanPath(folder));
    if (wanted.exists() || wanted.isSymLink()) return wanted.isDir();
    constexpr QFile::Permissions mode = OwnerOnly | QFile::ExeOwner;
    return makePrivateFolder(wanted.absolutePath()) && QDir().mkdir(wanted.filePath(), mode) &&
           QFile::setPermissions(wanted.filePath(), mode);
}

}  // namespace core
