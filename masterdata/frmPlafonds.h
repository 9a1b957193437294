// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Bound.h"
#include "platform/forms/Controls.h"
#include "platform/forms/DataGrid.h"
#include "platform/forms/Form.h"

namespace masterdata {

/// The list of the main rubrics.
class frmPlafonds : public forms::Form {
    Q_OBJECT
public:
    frmPlafonds();

    forms::DataControl* Adodc1;  ///< the rubrics; the caller gives the set
    /// Takes the set for the list.
    void setRows(const ado::RecordsetPtr& rubrics);

private:
    void layOut();
    void Command2_Click();
    void Command3_Click();
    void Command4_Click();

    forms::DataGrid* DataGrid1;
    forms::Button* Command1;
    forms::Button* Command2;
    forms::Button* Command3;
    forms::Button* Command4;
};

}  // namespace masterdata
