// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"
#include "platform/forms/ListBox.h"
#include "platform/forms/TextBox.h"

class QLabel;

namespace reports {

/// Prints declarations of what members paid themselves in a closed year, for their income tax.
class frmIRS : public forms::Form {
    Q_OBJECT
public:
    frmIRS();

private:
    void layOut();
    QWidget* beneficiaryFrame();
    QWidget* familyFrame();
    void connectHandlers();
    void Form_Load();
    void Option1_Click();
    void Option2_Click();
    void No_Kor_Validate(bool& cancel);
    void Command3_Click();
    QString missing() const;
    QWidget* fieldNamedBy(const QString& text) const;
    QStringList codesChosen() const;

    forms::OptionButton* Option1;
    forms::OptionButton* Option2;
    forms::TextBox* No_Kor;
    forms::TextBox* Text2;
    forms::ListBox* List1;
    forms::ListBox* List2;
    forms::Button* Command3;
    forms::Button* Command1;
    QLabel* Label4 = nullptr;
    qint32 socio_id_ = 0;  ///< of the member whose number stands in No_Kor
};

}  // namespace reports
