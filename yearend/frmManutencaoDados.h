// SPDX-License-Identifier: MIT
#pragma once

#include "yearend/JobScreen.h"

namespace yearend {

/// Data maintenance: repairs null amounts and makes the accumulators anew.
class frmManutencaoDados : public JobScreen {
    Q_OBJECT
public:
    frmManutencaoDados();

    /// After a run the screen can only be closed.
    void offerLeavingOnly();

private:
    forms::Button* Command1;
    forms::Button* Command2;
};

}  // namespace yearend
