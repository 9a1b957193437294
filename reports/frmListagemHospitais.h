// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Controls.h"
#include "platform/forms/DatePicker.h"
#include "platform/forms/Form.h"

namespace reports {

/// Lists the movements of each hospital that sent bills in a range of days.
class frmListagemHospitais : public forms::Form {
    Q_OBJECT
public:
    frmListagemHospitais();

private:
    void layOut();
    void Command1_Click();

    forms::DatePicker* Text1;
    forms::DatePicker* Text2;
    forms::CheckBox* Check1;
    forms::Button* Command1;
    forms::Button* Command2;
};

}  // namespace reports
