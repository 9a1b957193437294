// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

namespace host {

/// Runs work that may take seconds in a thread of its own and waits for it; meanwhile the windows
/// are painted and take no keys. Fails as the work does.
void beside(const std::function<void()>& work);

}  // namespace host
