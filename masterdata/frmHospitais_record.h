// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Bound.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"
#include "platform/forms/TextBox.h"

namespace masterdata {

/// A hospital. No box has to be filled.
class frmHospitais_record : public forms::Form {
    Q_OBJECT
public:
    frmHospitais_record();

    forms::DataControl* Adodc1;

private:
    void layOut();
    void connectHandlers();
    void limitFocused();
    void Command1_Click();

    forms::TextBox* Text1;
    forms::TextBox* Text2;
    forms::TextBox* Text3;
    forms::TextBox* Text4;
    forms::TextBox* Text5;
    forms::TextBox* Text6;
    forms::TextBox* Text7;
    forms::TextBox* Text8;
    forms::Button* Command1;
    forms::Button* Command2;
};

}  // namespace masterdata
