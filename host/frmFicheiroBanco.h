// SPDX-License-Identifier: MIT
#pragma once

#include "host/bankfile/BankFile.h"
#include "platform/forms/Controls.h"
#include "platform/forms/DatePicker.h"
#include "platform/forms/Form.h"

class QComboBox;
class QLabel;
class QTabWidget;

namespace host {

class TextTable;

/// Makes the file by which the bank is told to make the transfers of some days, and shows those
/// that were made.
class frmFicheiroBanco : public forms::Form {
    Q_OBJECT
public:
    /// Shows the transfers of today. Fails when the book, the settings or the records cannot be
    /// read.
    frmFicheiroBanco();

private:
    forms::Frame* daysFrame();
    forms::Frame* accountFrame();
    void layOut();
    void showAccount(const bankfile::PayingAccount& account);
    bankfile::PayingAccount typedAccount() const;
    bool keepAccount();
    bool haveDays();
    bankfile::Batch read() const;
    void show(bankfile::Batch batch);
    void showFiles();
    bool isAsShown();
    bool goesWithoutRefused();
    bankfile::Repetition askRepetition(const std::vector<bankfile::Repeated>& repeated);
    QString chosenFile();
    void Command1_Click();
    void Command2_Click();
    void Command4_Click();

    forms::DatePicker* Text1;  ///< first day
    forms::DatePicker* Text2;  ///< last day
    forms::TextBox* Text3;     ///< the account that pays
    forms::TextBox* Text4;     ///< name of the organisation
    forms::TextBox* Text5;     ///< its identifier
    forms::TextBox* Text6;     ///< the bank's code
    QComboBox* Combo1;         ///< form of the file
    forms::Button* Command1;
    forms::Button* Command2;
    forms::Button* Command3;
    forms::Button* Command4;
    QTabWidget* Tab1;
    TextTable* Table1;  ///< what goes
    TextTable* Table2;  ///< what cannot go
    TextTable* Table3;  ///< files that were made
    QLabel* Label1;     ///< count and sum of what goes
    QLabel* Label2;     ///< the same of what cannot go
    bankfile::Batch batch_;
};

}  // namespace host
