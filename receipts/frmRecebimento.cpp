// SPDX-License-Identifier: MIT
#include "receipts/frmRecebimento.h"

#include <QGridLayout>
#include <QLabel>

#include "data/Codes.h"
#include "data/Members.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "receipts/receipt.h"

using namespace Qt::StringLiterals;

namespace receipts {

using forms::addPair;

frmRecebimento::frmRecebimento()
    : AccountScreen(u"frmRecebimento"_s),
      Text3(forms::textBox(u"Text3"_s, core::format::Date)),
      Text4(forms::textBox(u"Text4"_s)),
      Command2(new forms::Button(u"Command2"_s, u"Anular"_s)) {
    Command2->setKey(u"Alt+A"_s);
    layOut(u"Recebimento"_s, u"Registo do dinheiro que o associado entrega ao Plano de Saúde."_s,
           {receiptFrame()}, {Command2, Command3, Command4});
    Command2->hide();
    forms::bindAll(Adodc1, {{Text3, u"data"_s}, {Text4, u"cheque"_s}});
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Command2_Click(); };
    forms::tabThrough(
        {No_Kor, Command1, Text3, Credito, DataCombo3, Text4, Text1, Command3, Command2, Command4});
}

QWidget* frmRecebimento::receiptFrame() {
    auto* frame = new forms::Frame(u"Frame2"_s, u"Recebimento:"_s);
    QGridLayout* grid = forms::pairsIn(frame, {u"Modo de Pagamento:", u"Número do Cheque:"});
    addPair(grid, 0, 0, u"&Data:"_s, Text3);
    addPair(grid, 0, 1, u"Tipo:"_s, Text8);
    addPair(grid, 1, 0, u"&Valor a Creditar:"_s, Credito);
    addPair(grid, 2, 0, u"&Modo de Pagamento:"_s, DataCombo3);
    addPair(grid, 2, 1, u"Número do C&heque:"_s, Text4);
    Text4->setMinimumWidth(forms::widthFor(Text4, u"0000000000"));
    return frame;
}

void frmRecebimento::showReadOnly(const ado::RecordsetPtr& rows) {
    AccountScreen::showReadOnly(rows);
    Command2->show();
}

void frmRecebimento::setDefaults() {
    Text3->setValue(core::fromDate(core::today()));
    Text8->setText(data::tipo::Receipt.toString());
    DataCombo3->setBoundText(data::modo::Cheque.toString());
}

/// Intentional: the date goes grey as well, and stays so.
void frmRecebimento::numberWiped() {
    AccountScreen::numberWiped();
    Text3->setBackColor(forms::BackColor::Menu);
}

QWidget* frmRecebimento::fieldNamedBy(const QString& text) const {
    return text.contains("data do registo"_L1) ? Text3 : AccountScreen::fieldNamedBy(text);
}

/// Gives up without a word when anything fails.
void frmRecebimento::Command1_Click() {
    core::passingOver([this] {
        const qint32 id = data::chooseMember(data::openSearch());
        if (id == 0) return;
        noteChoice();
        if (const ado::RecordsetPtr member = data::openEnrolledMember(id)) {
            const QString nome = core::toText(member->Collect(u"nome"_s));
            No_Kor->setText(core::toText(member->Collect(u"no_kor"_s)));
            takeMember(id, nome);
            Text3->setFocus(Qt::TabFocusReason);
        } else {
            No_Kor->Clear();
            clearMember();
        }
    });
}

void frmRecebimento::post() {
    const Receipt receipt{.record = Adodc1->Recordset(),
                          .socio_id = Socio_ID,
                          .caption = Caption(),
                          .paymentMode = DataCombo3->Text(),
                          .memberNumber = No_Kor->Text(),
                          .credit = Credito->Text()};
    if (postReceipt(receipt, operation)) return Unload();
    if (operation.isRegistered) lockFields();
}

void frmRecebimento::Command2_Click() {
    if (annulReceipt(Adodc1->Recordset(), Caption(), operation)) Unload();
}

}  // namespace receipts
