// SPDX-License-Identifier: MIT
#include "entry/frmMovimentosF.h"

#include <QBoxLayout>
#include <QLabel>

#include "platform/forms/SmallScreen.h"

using namespace Qt::StringLiterals;

namespace entry {

frmMovimentosF::frmMovimentosF()
    : Form(u"frmMovimentosF"_s, u"Sair de Lançamentos"_s),
      Label2(new QLabel),
      Option1(new forms::OptionButton(u"Option1"_s, u"&Sair"_s)),
      Option2(
          new forms::OptionButton(u"Option2"_s, u"Continuar a registar com o mesmo &Associado"_s)),
      Option3(new forms::OptionButton(u"Option3"_s, u"Imprimir &Extratos de Lançamentos"_s)),
      Option4(
          new forms::OptionButton(u"Option4"_s, u"&Continuar a registar com um novo Associado"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&OK"_s)) {
    layOut();
    Option2->setChecked(true);
    Option2->setFocus();
    Command1->onClick = [this] { Command1_Click(); };
    onUnload = [this] { choose(Choice::Leave); };
}

void frmMovimentosF::layOut() {
    auto* frame = new forms::Frame(u"Frame1"_s, QString());
    auto* options = new QVBoxLayout(frame);
    options->setContentsMargins(16, 12, 16, 12);
    options->setSpacing(8);
    Label2->setObjectName(u"Label2"_s);
    QFont bold = Label2->font();
    bold.setBold(true);
    Label2->setFont(bold);
    Label2->hide();
    options->addWidget(Label2);
    auto* question = new QLabel(u"Escolha uma das seguintes opções:"_s);
    question->setObjectName(u"Label1"_s);
    options->addWidget(question);
    for (forms::OptionButton* option : {Option2, Option4, Option3, Option1})
        options->addWidget(option);

    forms::layOutSmallScreen(this, frame, Command1, 380);
}

void frmMovimentosF::tell(const QString& outcome) {
    Label2->setText(outcome);
    Label2->setVisible(!outcome.isEmpty());
}

void frmMovimentosF::offerOtherMember() {
    Option2->hide();
    Option3->hide();
    Option4->setChecked(true);
    Option4->setFocus();
}

void frmMovimentosF::Command1_Click() {
    if (Option2->isChecked())
        choose(Choice::SameMember);
    else if (Option1->isChecked())
        choose(Choice::Leave);
    else if (Option3->isChecked())
        choose(Choice::Extracts);
    else if (Option4->isChecked())
        choose(Choice::NewMember);
}

void frmMovimentosF::choose(Choice choice) {
    // A copy: following the choice may unload this screen.
    const std::function<void(Choice)> report = onChosen;
    if (report) report(choice);
}

}  // namespace entry
