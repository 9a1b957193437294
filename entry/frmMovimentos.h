// SPDX-License-Identifier: MIT
#pragma once

#include <QVariant>

#include "coverage/Posting.h"
#include "platform/com/Component.h"
#include "platform/forms/DataCombo.h"
#include "platform/forms/RecordScreen.h"
#include "platform/forms/TextBox.h"

class QLabel;

namespace entry {

/// Entry of a medical document or a hospital bill, and the read-only view of one.
class frmMovimentos : public forms::RecordScreen {
    Q_OBJECT
public:
    frmMovimentos();

    qint32 Socio_ID = 0;  ///< the chosen member; 0 for none
    QVariant Familia_ID;  ///< the chosen person's family row; null until one was chosen
    bool bHospital = false;
    QPointer<QObject> CallbackClass;  ///< told of an annulment; may be null

    /// Called when the entry was posted or given up, with a sentence that says which; the screen
    /// is hidden by then.
    std::function<void(const QString& outcome)> onLeft;

    /// The form of a hospital entry, before the row is given.
    void showAsHospital();
    /// Nothing of an entry that another one takes the place of: neither its person nor its result.
    void forgetEntry();
    /// True once the entry stands in the book, also where something of it is missing.
    bool isRegistered() const { return operation_.isRegistered; }
    /// A member already known from the entry before.
    void setMember(qint32 id, const QString& number, const QString& name);
    /// The number of the chosen member. What stands in No_Kor may be another one, typed since and
    /// never accepted.
    const QString& memberNumber() const { return memberNumber_; }
    /// The read-only view of the row that Adodc1 holds, whose type is `tipo`.
    void showReadOnly(const QString& tipo);

    forms::TextBox* No_Kor;
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
    forms::DataCombo* DataCombo1;
    forms::DataCombo* DataCombo2;
    forms::DataCombo* DataCombo3;
    forms::DataCombo* DataCombo4;
    forms::TextBox* Incidencia;
    forms::TextBox* Comparticipacao;
    forms::TextBox* LimiteAplicavel;
    forms::TextBox* SaldoCC;
    forms::TextBox* Iliquido;
    forms::TextBox* SaldoPlafond;
    forms::TextBox* Credito;
    forms::TextBox* Debito;
    forms::TextBox* Liquido;
    forms::Button* Command1;
    forms::Button* Command2;
    forms::Button* Command5;
    forms::Button* Command6;
    QLabel* Label12;
    QLabel* Label18;
    QLabel* Label19;

protected:
    void setDefaults() override;
    void post() override;
    bool stopsEnter(const QWidget* control) const override;

private:
    void makeControls();
    void layOut();
    QWidget* beneficiaryFrame();
    QWidget* documentFrame();
    QWidget* propertiesFrame();
    QWidget* resultFrame();
    void setTabOrders();
    void bindControls();
    void connectHandlers();
    void connectFieldHandlers();

    void No_Kor_Validate(bool& cancel);
    void Command1_Click();
    void Command2_Click();
    void Text1_Validate(bool& cancel);
    void Text5_GotFocus();
    void Text6_Validate(bool& cancel);
    void Text11_Validate(bool& cancel);
    void Command4_Click();
    void Command5_Click();
    void Command6_Click();
    void explain();

    void takeMemberFound(ado::Recordset& member);
    void searchMember();
    void clearMember();
    void workOutVat();
    void rateHoldsAValue();
    QWidget* fieldNamedBy(const QString& text) const;
    void leaveEntry(const QString& outcome);
    coverage::Document document() const;
    coverage::TryOut tryOutShown();

    /// A result of the try-out: its control, and the column that keeps it.
    struct ResultBox {
        coverage::Result result;
        forms::TextBox* box;
        QString column;  ///< empty for none
    };
    std::vector<ResultBox> resultBoxes() const;

    /// What a try-out came to, and what it was asked of: when that has changed since, it explains
    /// another document than the screen shows.
    struct Explained {
        coverage::Explanation explanation;
        QVariantList of;
    };
    QVariantList asked() const;
    void tryOutAs(const std::function<void(coverage::TryOut& run)>& work);

    com::Object search_;  ///< the last search component; keeps its premium extract open
    QString memberNumber_;
    std::optional<Explained> explained_;  ///< the last try-out of this entry
    data::Operation operation_;           ///< the posting or annulment that this screen is for
};

}  // namespace entry
