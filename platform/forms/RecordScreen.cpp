// SPDX-License-Identifier: MIT
#include "platform/forms/RecordScreen.h"

#include "platform/forms/DataCombo.h"
#include "platform/forms/MultiLineBox.h"
#include "platform/forms/TextBox.h"

using namespace Qt::StringLiterals;

namespace forms {

RecordScreen::RecordScreen(const QString& name, const QString& caption)
    : Form(name, caption),
      Adodc1(new DataControl(u"Adodc1"_s, this)),
      Command3(new Button(u"Command3"_s, u"&OK"_s, this)),
      Command4(new Button(u"Command4"_s, u"&Cancelar"_s, this)),
      Timer1(new Timer(u"Timer1"_s, 1, this)) {
    Timer1->onTimer = [this] { Timer1_Timer(); };
    Command3->onClick = [this] { Command3_Click(); };
    setCancelButton(Command4);
}

void RecordScreen::showNew(const ado::RecordsetPtr& rows) {
    Adodc1->setRecordset(rows);
    rows->AddNew();
    bShowing = false;
    Timer1->setEnabled(true);
    Show();
}

void RecordScreen::showForReading() {
    Timer1->setEnabled(false);
    bShowing = true;
    Command4->hide();
    Command3->setCaption(u"&Sair"_s);
    Command3->setDefault(true);
    setCancelButton(Command3);
    Command3->setFocus();
}

void RecordScreen::lockFields() {
    for (TextBox* box : findChildren<TextBox*>()) box->setLocked(true);
    for (DataCombo* combo : findChildren<DataCombo*>()) combo->setLocked(true);
    for (MultiLineBox* box : findChildren<MultiLineBox*>()) box->setLocked(true);
}

void RecordScreen::Timer1_Timer() {
    // The view has no defaults to set; the timer stays as it is.
    if (bShowing) return;
    Timer1->setEnabled(false);
    setDefaults();
}

void RecordScreen::Command3_Click() {
    if (Command3->Caption() == u"&Sair"_s)
        Unload();
    else
        post();
}

}  // namespace forms
