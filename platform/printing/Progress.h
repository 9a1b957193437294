// SPDX-License-Identifier: MIT
#pragma once

#include <QProgressDialog>

#include "platform/printing/Output.h"

namespace printing {

/// Of the dialogs that show how far long work has come, in pixels.
inline constexpr int ProgressWidth = 320;

/// Shows how far long work has come, and lets the person give it up. It is not seen while the work
/// takes less than half a second.
class Progress {
public:
    /// @param parent  whose window cannot be used meanwhile; nothing can be used when it is null
    /// @param steps   of which show() tells
    Progress(QWidget* parent, const QString& title, const QString& text, int steps);

    /// Tells how many steps are done and takes the person's clicks and keys. False once the person
    /// has given up.
    bool show(int done);
    GoesOn goesOn() {
        return [this](int done) { return show(done); };
    }

private:
    QProgressDialog dialog_;
};

}  // namespace printing
