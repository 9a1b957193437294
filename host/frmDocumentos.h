// SPDX-License-Identifier: MIT
#pragma once

#include "host/documents/Output.h"
#include "platform/forms/Controls.h"
#include "platform/forms/DatePicker.h"
#include "platform/forms/Form.h"

class QComboBox;
class QLabel;

namespace host {

/// Makes the extracts, debt letters or tax declarations of all members, as a PDF each or as one.
class frmDocumentos : public forms::Form {
    Q_OBJECT
public:
    /// Fails when the book cannot be opened.
    frmDocumentos();

private:
    using Make = std::function<documents::Made(const documents::GoesOn& goesOn)>;

    void layOut();
    void showKind();
    documents::Kind kind() const;
    documents::Wish wish() const;
    bool isComplete();
    void Command1_Click();
    void Command2_Click();
    void make(const QString& where, const Make& make);

    const ado::ConnectionPtr book_;
    forms::OptionButton* Option1;  ///< extracts
    forms::OptionButton* Option2;  ///< letters
    forms::OptionButton* Option3;  ///< declarations
    forms::DatePicker* Text1;      ///< first day
    forms::DatePicker* Text2;      ///< last day
    forms::CheckBox* Check1;       ///< detailed
    QComboBox* Combo1;             ///< the closed years
    QLabel* Label1 = nullptr;
    QLabel* Label2 = nullptr;
    QLabel* Label3 = nullptr;
    forms::Button* Command1;  ///< a PDF each
    forms::Button* Command2;  ///< one PDF
    forms::Button* Command3;
};

}  // namespace host
