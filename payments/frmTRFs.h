// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Controls.h"
#include "platform/forms/DataCombo.h"
#include "platform/forms/DatePicker.h"
#include "platform/forms/Form.h"

namespace payments {

/// Lists what is paid in a range of days, by cheque or by transfer, and hands the transfers to the
/// bank's program.
class frmTRFs : public forms::Form {
    Q_OBJECT
public:
    frmTRFs();

private:
    void layOut();
    void Command1_Click();
    void Command31_Click();
    QDate first() const;
    QDate last() const;

    forms::DatePicker* Text1;
    forms::DatePicker* Text2;
    forms::DataCombo* DataCombo1;
    forms::CheckBox* Check1;
    forms::Button* Command1;
    forms::Button* Command2;
    forms::Button* Command31;
};

}  // namespace payments
