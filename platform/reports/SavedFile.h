// SPDX-License-Identifier: MIT
#pragma once

#include <QSaveFile>

#include "platform/core/Failure.h"

namespace reports {

/// Fails with what kept a file from being written.
[[noreturn]] inline void failToWrite(const QSaveFile& file) {
    throw core::Failure(core::InvalidCall, QStringLiteral("Não foi possível escrever «%1»: %2")
                                               .arg(file.fileName(), file.errorString()));
}

}  // namespace reports
