// SPDX-License-Identifier: MIT
#pragma once

#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"
#include "platform/forms/TextBox.h"
#include "platform/registry/LoginValues.h"

namespace host {

/// Where a book on a server lies, and who enters it.
class frmServidor : public forms::Form {
    Q_OBJECT
public:
    explicit frmServidor(const registry::LoginValues& proposed);

    /// Called on "&Ligar"; the screen closes when it returns, and stays when it fails.
    std::function<void(const registry::LoginValues& book)> onAccepted;

private:
    void layOut();
    void Command1_Click();
    QWidget* missing() const;

    forms::TextBox* Text1;    ///< host
    forms::TextBox* Text2;    ///< port
    forms::TextBox* Text3;    ///< catalogue
    forms::TextBox* Text4;    ///< user
    forms::TextBox* Text5;    ///< password
    forms::CheckBox* Check1;  ///< no encryption
    forms::Button* Command1;
    forms::Button* Command2;
};

}  // namespace host
