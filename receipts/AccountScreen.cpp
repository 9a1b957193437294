// SPDX-License-Identifier: MIT
#include "receipts/AccountScreen.h"

#include <QGridLayout>
#include <QLabel>

#include "boundary/environment/dtZelmars.h"
#include "data/Codes.h"
#include "data/Members.h"
#include "data/MovementNote.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace receipts {

using forms::BackColor;
using forms::fieldLabel;
namespace format = core::format;

AccountScreen::AccountScreen(const QString& name)
    : RecordScreen(name, u"Lançamento de Zelmar"_s),
      No_Kor(forms::textBox(u"No_Kor"_s, format::Number)),
      Text2(forms::displayBox(u"Text2"_s)),
      Text8(forms::displayBox(u"Text8"_s)),
      Credito(forms::textBox(u"Credito"_s, format::Money)),
      DataCombo3(new forms::DataCombo(u"DataCombo3"_s)),
      Text1(new forms::MultiLineBox(u"Text1"_s)),
      Command1(new forms::Button(u"Command1"_s, u"Procurar Sócio"_s)) {
    Command1->setKey(u"Alt+P"_s);
    DataCombo3->setMinimumWidth(forms::widthFor(DataCombo3, data::modo::Widest));
    makeBeneficiaryFrame();
    bindControls();
    No_Kor->onValidate = [this](bool& cancel) { No_Kor_Validate(cancel); };
    Credito->onGotFocus = [this] { Credito->SelectAll(); };
    onBoxClosed = [this](const QString& text) { return fieldNamedBy(text); };
    Command4->onClick = [this] {
        if (mayGiveUp()) Unload();
    };
}

QWidget* AccountScreen::fieldNamedBy(const QString& text) const {
    if (text.contains("modo de pagamento"_L1)) return DataCombo3;
    if (text.contains(u"indicar um Sócio"_s)) return No_Kor;
    if (text.contains("valor"_L1) && text.contains(u"para o crédito"_s)) return Credito;
    return nullptr;
}

void AccountScreen::bindControls() {
    DataCombo3->setList(environment::dtZelmars::instance().Recordsets(u"msModosPagamento"_s),
                        u"completo"_s, u"code"_s);
    forms::bindAll(Adodc1, {{DataCombo3, u"modo_pagamento"_s},
                            {Text8, u"tipo"_s},
                            {Credito, u"credito"_s},
                            {Text1, u"descrit"_s}});
}

void AccountScreen::showReadOnly(const ado::RecordsetPtr& rows) {
    Adodc1->setRecordset(rows);
    forms::bindAll(Adodc1, {{No_Kor, u"no_kor"_s}, {Text2, u"nome"_s}});
    Text2->setBackColor(BackColor::Window);
    lockFields();
    for (forms::TextBox* box : findChildren<forms::TextBox*>())
        if (box != Text2) box->setBackColor(BackColor::Menu);
    Command1->hide();
    showForReading(data::noteOf(*rows));
}

/// Intentional: whether the member is enrolled in the plan is not tested here, only where a search
/// of the screen's own does.
void AccountScreen::No_Kor_Validate(bool& cancel) {
    if (bShowing()) return;
    if (No_Kor->Text().isEmpty()) {
        numberWiped();
        return;
    }
    const QVariant found = data::memberIdOf(No_Kor->Text());
    if (core::isNullOrEmpty(found)) {
        clearMember();
        core::MsgBox(u"Número KOR não encontrado!"_s, core::Icon::Critical, u"Sócios"_s);
        cancel = true;
        return;
    }
    const qint32 id = core::toLong(found);
    takeMember(id, core::toText(data::ofMember(id, u"nome"_s)));
}

/// The key comes last: whoever it stands for is on the screen by then.
void AccountScreen::takeMember(qint32 socio_id, const QString& nome) {
    Text2->setText(nome);
    Text2->setBackColor(BackColor::Window);
    Socio_ID = socio_id;
}

void AccountScreen::forgetEntry() {
    No_Kor->Clear();
    clearMember();
    operation = {};
}

void AccountScreen::clearMember() {
    forms::greyOut({Text2});
    Socio_ID = 0;
}

void AccountScreen::makeBeneficiaryFrame() {
    beneficiaryFrame_ = new forms::Frame(u"Frame1"_s, u"Identificação do Beneficiário:"_s);
    beneficiary_ = forms::pairsIn(beneficiaryFrame_, {u"Modo de Pagamento:"});
    forms::addRow(beneficiary_, 0, u"Número &KOR:"_s, {No_Kor, Text2, Command1});
    No_Kor->setFixedWidth(forms::widthFor(No_Kor, u"0000000000"));
    Text2->setAccessibleName(u"Nome do sócio"_s);
    Text2->setMinimumWidth(forms::widthFor(Text2, u"Maria da Conceição de Vasconcelos"));
    beneficiary_->setColumnStretch(2, 1);
}

QWidget* AccountScreen::notesFrame() {
    auto* frame = new forms::Frame(u"Frame4"_s, u"Obeservações"_s);
    QGridLayout* grid = forms::pairsIn(frame, {u"Modo de Pagamento:"});
    grid->addWidget(fieldLabel(u"&Notas:"_s, Text1), 0, 0, Qt::AlignTop | Qt::AlignRight);
    grid->addWidget(Text1, 0, 1);
    grid->setColumnStretch(1, 1);
    return frame;
}

void AccountScreen::layOut(const QString& title, const QString& explanation,
                           std::initializer_list<QWidget*> frames,
                           std::initializer_list<forms::Button*> buttons) {
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(title, explanation, u"Label25"_s, u"Label26"_s, u"Image1"_s), this);
    body->addWidget(beneficiaryFrame_);
    for (QWidget* frame : frames) body->addWidget(frame);
    body->addWidget(notesFrame(), 1);
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    for (forms::Button* button : buttons) foot->addWidget(button);
    body->addLayout(foot);
    // Posting wants its own key.
    letEnterGoOn(nullptr);
    No_Kor->setFocus();
}

}  // namespace receipts
