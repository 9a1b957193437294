// SPDX-License-Identifier: MIT
#pragma once

#include "platform/ado/Recordset.h"
#include "platform/forms/Controls.h"
#include "platform/forms/DatePicker.h"
#include "platform/forms/Form.h"

class QLabel;

namespace reports {

struct Selection;

/// Prints the extract of a member's movements, or shows it.
class frmExtratos : public forms::Form {
    Q_OBJECT
public:
    frmExtratos();

    /// True when the screen that was left for this one comes back on "&Fechar".
    bool Show_Options = false;
    /// Brings that screen back.
    std::function<void()> onClosed;

    /// A member already known; 0 and empty texts for none.
    void setMember(qint32 id, const QString& number, const QString& name);

private:
    void makeControls();
    void layOut();
    QWidget* beneficiaryFrame();
    QWidget* kindFrame();
    void connectHandlers();

    void No_Kor_Validate(bool& cancel);
    void Command1_Click();
    void showOption();
    void Imprimir_Click();
    void Command4_Click();

    void clearMember();
    /// What is missing before anything can be printed; empty for nothing.
    QString missing() const;
    QWidget* fieldNamedBy(const QString& text) const;
    Selection selection() const;
    void print(const ado::Recordset& member);

    qint32 socio_id_ = 0;  ///< the chosen member; 0 for none

    forms::TextBox* No_Kor;
    forms::TextBox* Text1;
    forms::TextBox* Text2;
    forms::DatePicker* Text3;
    forms::DatePicker* Text4;
    QLabel* Label2;
    forms::OptionButton* Option1;
    forms::OptionButton* Option2;
    forms::CheckBox* Check1;
    forms::CheckBox* Check2;
    forms::Button* Command1;
    forms::Button* Command4;
    forms::Button* Imprimir;
};

}  // namespace reports
