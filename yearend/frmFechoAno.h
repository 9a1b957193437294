// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/TextBox.h"
#include "yearend/JobScreen.h"

namespace yearend {

/// The close of the plan year.
class frmFechoAno : public JobScreen {
    Q_OBJECT
public:
    frmFechoAno();

private:
    void Form_Load();
    void Command2_Click();
    void close();

    forms::TextBox* Text1;
    forms::Button* Command1;
    forms::Button* Command2;
};

}  // namespace yearend
