// SPDX-License-Identifier: MIT
#pragma once

#include <QTimer>
#include <chrono>

#include "platform/core/Wait.h"

namespace host {

/// True while the book is being waited for, when it must not be read: the caller returns, and
/// `again` is called a little later, unless `owner` is gone by then. It is to ask here once more.
template <class Again>
bool leftForLater(QObject* owner, const Again& again) {
    if (!core::isWaiting()) return false;
    QTimer::singleShot(std::chrono::milliseconds(100), owner, again);
    return true;
}

}  // namespace host
