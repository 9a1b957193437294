// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <ostream>

#include "platform/core/Failure.h"

/// So that a failing comparison shows the text.
inline void PrintTo(const QString& text, std::ostream* out) {
    *out << '"' << text.toStdString() << '"';
}

namespace support {

/// What the action fails with; number 0 and no text when it does not fail.
template <class Action>
core::Failure failureOf(Action&& action) {
    try {
        action();
    } catch (const core::Failure& failure) {
        return failure;
    }
    return {0, {}};
}

}  // namespace support
