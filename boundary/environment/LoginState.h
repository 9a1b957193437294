// SPDX-License-Identifier: MIT
#pragma once

#include "platform/registry/LoginValues.h"

namespace environment {

/// The component's state: one copy, shared by all `General` objects and all screens. The five texts
/// keep the values last read, also after a login that failed.
struct LoginState : registry::LoginValues {
    /// True from the moment both connections opened without error until the next login begins.
    bool bLoggedIn = false;
};

/// The state of the thread that asks.
LoginState& loginState();

}  // namespace environment
