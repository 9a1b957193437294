// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Bound.h"
#include "platform/forms/Controls.h"
#include "platform/forms/DataGrid.h"
#include "platform/forms/Form.h"

namespace masterdata {

/// The list of the hospitals.
class frmHospitais : public forms::Form {
    Q_OBJECT
public:
    frmHospitais();

    forms::DataControl* Adodc1;  ///< the hospitals; the caller gives the set
    /// Takes the set for the list.
    void setRows(const ado::RecordsetPtr& hospitals);

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
