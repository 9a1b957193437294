// SPDX-License-Identifier: MIT
#pragma once

#include "receipts/AccountScreen.h"

namespace receipts {

/// Money that a member pays in, and the read-only view of such a receipt, which can be annulled
/// there.
class frmRecebimento : public AccountScreen {
    Q_OBJECT
public:
    frmRecebimento();
    void showReadOnly(const ado::RecordsetPtr& rows) override;

    forms::TextBox* Text3;
    forms::TextBox* Text4;
    forms::Button* Command2;

protected:
    void setDefaults() override;
    void post() override;
    void numberWiped() override;
    QWidget* fieldNamedBy(const QString& text) const override;

private:
    QWidget* receiptFrame();
    void Command1_Click();
    void Command2_Click();
};

}  // namespace receipts
