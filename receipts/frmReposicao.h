// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>

#include "platform/com/Component.h"
#include "receipts/AccountScreen.h"

namespace receipts {

/// A correction of a member's account, typed by hand, and the read-only view of one. It is undone
/// by another one, not annulled.
class frmReposicao : public AccountScreen {
    Q_OBJECT
public:
    frmReposicao();
    void showReadOnly(const ado::RecordsetPtr& rows) override;

    QVariant Familia_ID = 0;  ///< the chosen person's family row; 0 for none

    forms::TextBox* Text3;
    forms::TextBox* Text4;
    forms::TextBox* Text7;
    forms::TextBox* Debito;
    forms::DataCombo* DataCombo1;
    forms::Button* Command2;

protected:
    void setDefaults() override;
    void post() override;
    void takeMember(qint32 socio_id, const QString& nome) override;
    void clearMember() override;
    QWidget* fieldNamedBy(const QString& text) const override;

private:
    void addPersonRow();
    QWidget* propertiesFrame();
    QWidget* resultFrame();
    void bindControls();
    static com::Object openMemberFile();
    void Command1_Click();
    void Command2_Click();
    void DataCombo1_LostFocus();
};

}  // namespace receipts
