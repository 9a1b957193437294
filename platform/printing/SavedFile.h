// SPDX-License-Identifier: MIT
#pragma once

#include <QSaveFile>

#include "platform/core/Failure.h"
#include "platform/core/PrivateFiles.h"

namespace printing {

/// Opens a file for writing that only its owner will read, also when it replaces one that others
/// could.
inline bool openPrivately(QSaveFile& file) {
    return file.open(QIODevice::WriteOnly) && file.setPermissions(core::OwnerOnly);
}

/// Fails with what kept a file from being written.
[[noreturn]] inline void failToWrite(const QSaveFile& file) {
    throw core::Failure(core::InvalidCall, QStringLiteral("Não foi possível escrever «%1»: %2")
                                               .arg(file.fileName(), file.errorString()));
}

}  // namespace printing
