// SPDX-License-Identifier: MIT
#pragma once

#include <QString>

namespace forms {

/// A failure that nobody trapped and that was caught around a handler. Its text is left out: it may
/// hold what was typed.
struct Caught {
    int number = 0;  ///< of core::Failure; 0 for any other
    QString code;    ///< the database engine's own, if it was the engine's
    QString screen;  ///< objectName of the window that was active
};

/// Told of each of them, before the person reads its text; it must not fail. There is one, or none.
using CaughtListener = void (*)(const Caught& caught);
void setCaughtListener(CaughtListener listener);

/// The objectName of the window that is active; empty where there is none.
QString activeScreen();

}  // namespace forms
