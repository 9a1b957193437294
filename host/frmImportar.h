// SPDX-License-Identifier: MIT
#pragma once

#include <optional>

#include "host/import/Import.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Form.h"

class QComboBox;
class QLabel;

namespace forms {

class TextBox;

}  // namespace forms

namespace host {

class TextTable;

/// Shows row by row what a file would bring into the book, and brings it.
class frmImportar : public forms::Form {
    Q_OBJECT
public:
    explicit frmImportar(const database::BookPlace& place);

    /// True once something was written.
    bool hasWritten() const { return hasWritten_; }

private:
    void layOut();
    void Command1_Click();
    void Command2_Click();
    void Command3_Click();
    void forget();
    void showRows();
    void showButtons();
    importing::Wish wish() const;

    const database::BookPlace place_;
    std::optional<importing::Plan> plan_;  ///< what is shown
    bool hasWritten_ = false;
    QComboBox* Combo1;        ///< the kind
    forms::TextBox* Text1;    ///< the file
    forms::Button* Command1;  ///< choose the file
    forms::Button* Command2;  ///< look
    forms::CheckBox* Check1;  ///< refused rows alone
    forms::CheckBox* Check2;  ///< without the refused ones
    TextTable* Grid1;
    QLabel* Label3;           ///< what it comes to
    forms::Button* Command3;  ///< import
    forms::Button* Command4;
};

}  // namespace host
