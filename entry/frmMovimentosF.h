// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

class QLabel;

namespace entry {

/// What to do after an entry was posted or given up.
class frmMovimentosF : public forms::Form {
    Q_OBJECT
public:
    enum class Choice { SameMember, NewMember, Extracts, Leave };

    frmMovimentosF();

    /// What became of the entry, beside the options.
    void tell(const QString& outcome);
    /// The choice that is left after the extracts: another member, or to leave.
    void offerOtherMember();

    /// Called on "OK" with the option chosen; closing the screen without a choice leaves.
    std::function<void(Choice)> onChosen;

private:
    void layOut();
    void Command1_Click();
    void choose(Choice choice);

    QLabel* Label2;  ///< what became of the entry
    forms::OptionButton* Option1;
    forms::OptionButton* Option2;
    forms::OptionButton* Option3;
    forms::OptionButton* Option4;
    forms::Button* Command1;
};

}  // namespace entry
