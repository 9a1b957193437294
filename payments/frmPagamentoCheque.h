// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"
#include "platform/forms/TextBox.h"

namespace payments {

/// Gives a document its cheque number, and keeps the running number.
class frmPagamentoCheque : public forms::Form {
    Q_OBJECT
public:
    /// @param movement  its current row takes the number; saving the row is its owner's work
    /// @param number    offered
    frmPagamentoCheque(const ado::RecordsetPtr& movement, const QString& number);

    /// Shows the screen with the next number and waits until it is gone. Fails when there is no
    /// next number to be read; the screen then does not come.
    static void ask(const ado::RecordsetPtr& movement);

private:
    void layOut();
    void step(int by);
    void Command1_Click();

    ado::RecordsetPtr movement_;
    forms::TextBox* Text1;
    forms::Button* Command1;
    forms::Button* Command2;
    forms::Button* Command3;
};

}  // namespace payments
