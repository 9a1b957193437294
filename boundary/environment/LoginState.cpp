// SPDX-License-Identifier: MIT
#include "boundary/environment/LoginState.h"

namespace environment {

LoginState& loginState() {
    // Each thread that calls the component has a state of its own.
    thread_local LoginState state;
    return state;
}

}  // namespace environment
