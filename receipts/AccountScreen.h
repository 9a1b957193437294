// SPDX-License-Identifier: MIT
#pragma once

#include "data/Operations.h"
#include "platform/forms/DataCombo.h"
#include "platform/forms/MultiLineBox.h"
#include "platform/forms/RecordScreen.h"
#include "platform/forms/TextBox.h"

class QGridLayout;

namespace receipts {

/// What a receipt and a reposition have in common on the screen: a member found by his number, the
/// mode of payment, the credit and the notes. Each screen finds its members by a search of its own.
class AccountScreen : public forms::RecordScreen {
    Q_OBJECT
public:
    qint32 Socio_ID = 0;  ///< the chosen member; 0 for none

    forms::TextBox* No_Kor;
    forms::TextBox* Text2;
    forms::TextBox* Text8;
    forms::TextBox* Credito;
    forms::DataCombo* DataCombo3;
    forms::MultiLineBox* Text1;
    forms::Button* Command1;

    /// True once the entry stands in the book, also where something of it is missing.
    bool isRegistered() const { return operation.isRegistered; }
    /// Nothing of an entry that another one takes the place of.
    void forgetEntry();
    /// The read-only view of the current row.
    virtual void showReadOnly(const ado::RecordsetPtr& rows);

protected:
    explicit AccountScreen(const QString& name);

    /// A member was found: his name is shown.
    virtual void takeMember(qint32 socio_id, const QString& nome);
    /// Nobody is chosen any more.
    virtual void clearMember();
    data::Operation operation;  ///< the posting or annulment that this screen is for

    /// What a refusal of the posting speaks of; null for nothing that can be filled in.
    virtual QWidget* fieldNamedBy(const QString& text) const;
    /// The number was wiped.
    virtual void numberWiped() { clearMember(); }

    // Layout: the heading, the frames given between the member's and the notes', the buttons.
    void layOut(const QString& title, const QString& explanation,
                std::initializer_list<QWidget*> frames,
                std::initializer_list<forms::Button*> buttons);
    /// The member's frame with its first row; a screen may add a second.
    QGridLayout* beneficiary() const { return beneficiary_; }

private:
    void makeBeneficiaryFrame();
    QWidget* notesFrame();
    void bindControls();
    void No_Kor_Validate(bool& cancel);

    QWidget* beneficiaryFrame_;
    QGridLayout* beneficiary_;
};

}  // namespace receipts
