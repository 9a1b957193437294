// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Bound.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"
#include "platform/forms/TextBox.h"

namespace masterdata {

/// A rubric of a group.
class frmPlafonds_record : public forms::Form {
    Q_OBJECT
public:
    frmPlafonds_record();

    forms::DataControl* Adodc1;

private:
    void layOut();
    QWidget* rubricFrame();
    QWidget* yearFrame();
    QWidget* postingFrame();
    void bindControls();
    void connectHandlers();
    void Text3_Validate(bool& cancel);
    void Command1_Click();

    forms::TextBox* Text1;
    forms::TextBox* Text2;
    forms::TextBox* Text3;
    forms::TextBox* Text4;
    forms::TextBox* Text5;
    forms::TextBox* Text6;
    forms::TextBox* Text7;
    forms::TextBox* Text8;
    forms::TextBox* Text9;
    forms::TextBox* Text10;
    forms::TextBox* Text11;
    forms::TextBox* Text12;
    forms::TextBox* Text13;
    forms::TextBox* Text14;
    forms::TextBox* Text15;
    forms::TextBox* Text16;
    forms::Button* Command1;
    forms::Button* Command2;
};

}  // namespace masterdata
