// SPDX-License-Identifier: MIT
#pragma once

#include "platform/com/Component.h"

namespace coverage {

/// The progress window of a try-out; the component behind it is let go with this object.
class Progress {
public:
    /// Makes the component; fails when there is none.
    Progress();
    /// Opens the window.
    void start();
    /// One step further.
    void advance();
    /// Closes the window and lets go of the component.
    void finish();

private:
    com::Object vorlane_;
};

}  // namespace coverage
