// SPDX-License-Identifier: MIT
#pragma once

#include <QTimer>
#include <chrono>

#include "platform/core/Wait.h"

namespace host {

/// True while the book is being waited for: what would read it then is tried again until nobody
/// waits any more, or `owner` is gone.
template <class Again>
bool leftForLater(QObject* owner, const Again& again) {
    if (!core::isWaiting()) return false;
    QTimer::singleShot(std::chrono::milliseconds(100), owner, again);
    return true;
}

}  // namespace host
