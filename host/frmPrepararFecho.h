// SPDX-License-Identifier: MIT
#pragma once

#include "host/frmVerificacao.h"
#include "platform/forms/TextBox.h"

namespace host {

/// What a person should know before a year is closed, and the backup that she will want if it goes
/// wrong.
class frmPrepararFecho : public forms::Form {
    Q_OBJECT
public:
    /// Looks at the book of the settings. Fails when it cannot be read.
    frmPrepararFecho();

    /// The backup stands, or could not be made on this machine and is not wanted: on to the close.
    bool mayGoOn() const { return mayGoOn_; }

private:
    void lookAtBook();
    void lookAtOthers();
    void layOut();
    forms::TextBox* addLine(class QGridLayout* grid, const QString& label, const QString& name,
                            forms::Button* button = nullptr);
    void showBalances(const QString& query, const QString& caption);
    void Command1_Click();

    forms::TextBox* Text1;  ///< movements that go to history
    forms::TextBox* Text2;  ///< debts that are carried
    forms::TextBox* Text3;  ///< balances that vanish
    forms::TextBox* Text4;  ///< what the check says
    forms::TextBox* Text5;  ///< who else has the book open
    forms::TextBox* Text6;  ///< the backup's file
    forms::TextBox* Text7;  ///< the year that the close proposes
    forms::CheckBox* Check1;
    forms::Button* Command1;
    forms::Button* Command2;
    forms::Button* Command3;
    forms::Button* Command4;
    forms::Button* Command5;
    forms::Button* Command6;
    CheckResult check_;
    bool canBackUp_ = true;
    bool mayGoOn_ = false;
};

}  // namespace host
