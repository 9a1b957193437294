// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Bound.h"
#include "platform/forms/Controls.h"
#include "platform/forms/DataGrid.h"
#include "platform/forms/Form.h"
#include "platform/forms/TextBox.h"

namespace masterdata {

/// A main rubric, and the list of its children. Leaving it is saving.
class frmPlafonds_Main : public forms::Form {
    Q_OBJECT
public:
    frmPlafonds_Main();

    forms::DataControl* Adodc1;  ///< the main rubric
    forms::DataControl* Adodc2;  ///< its children; without a set for a new one
    /// Takes the set of the children.
    void setChildren(const ado::RecordsetPtr& children);

private:
    void layOut();
    void bindControls();
    /// The row of the main rubric. Fails when it could not be opened.
    ado::Recordset& rubric() const;
    bool leaveField();
    void reject() override;
    void closeEvent(QCloseEvent* event) override;
    void save();
    void Command1_Click();
    void Command2_Click();
    void Command3_Click();

    forms::TextBox* Text1;
    forms::TextBox* Text2;
    forms::TextBox* Text4;
    forms::TextBox* Text5;
    forms::TextBox* Text7;
    forms::TextBox* Text9;
    forms::DataGrid* DataGrid1;
    forms::Button* Command1;
    forms::Button* Command2;
    forms::Button* Command3;
    forms::Button* Command4;
};

}  // namespace masterdata
