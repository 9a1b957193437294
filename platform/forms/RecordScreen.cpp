// SPDX-License-Identifier: MIT
#include "platform/forms/RecordScreen.h"

#include <QCloseEvent>

#include "platform/core/MsgBox.h"
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

void RecordScreen::attach(const ado::RecordsetPtr& rows) {
    mode_ = Mode::View;
    Adodc1->setRecordset(rows);
}

void RecordScreen::showNew(const ado::RecordsetPtr& rows) {
    Adodc1->setRecordset(rows);
    rows->AddNew();
    mode_ = Mode::New;
    watchTyping();
    typed_ = false;
    Timer1->setEnabled(true);
    Show();
}

void RecordScreen::watchTyping() {
    if (watching_) return;
    watching_ = true;
    // The lists' own lines among them.
    for (QLineEdit* line : findChildren<QLineEdit*>())
        connect(line, &QLineEdit::textEdited, this, &RecordScreen::noteChoice);
    for (QComboBox* list : findChildren<QComboBox*>())
        connect(list, &QComboBox::activated, this, &RecordScreen::noteChoice);
    for (MultiLineBox* box : findChildren<MultiLineBox*>())
        connect(box, &MultiLineBox::textEdited, this, &RecordScreen::noteChoice);
}

bool RecordScreen::mayGiveUp() {
    if (!isUnderWay() || !typed_) return true;
    return core::MsgBox(u"Há dados por lançar, que se perdem.\nQuer deixar o lançamento?"_s,
                        core::Icon::Question, Caption(), core::Buttons::NoYes) == core::Answer::Yes;
}

void RecordScreen::closeEvent(QCloseEvent* event) {
    const Turn turn(this);
    if (turn && mayGiveUp())
        Form::closeEvent(event);
    else
        event->ignore();
}

void RecordScreen::showForReading(const QString& note) {
    setBandNote(this, note);
    Timer1->setEnabled(false);
    mode_ = Mode::View;
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
    // What stands in the fields is in the book; nothing of it is lost with the screen.
    typed_ = false;
}

void RecordScreen::Timer1_Timer() {
    // The view has no defaults to set; the timer stays as it is.
    if (bShowing()) return;
    Timer1->setEnabled(false);
    setDefaults();
}

void RecordScreen::Command3_Click() {
    if (bShowing())
        Unload();
    else
        post();
}

}  // namespace forms
