// SPDX-License-Identifier: MIT
#include "receipts/frmReposicao.h"

#include <QGridLayout>
#include <QLabel>

#include "boundary/environment/dtZelmars.h"
#include "data/Codes.h"
#include "data/Members.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "receipts/reposition.h"

using namespace Qt::StringLiterals;

namespace receipts {

using forms::addPair;
namespace format = core::format;

namespace {

/// Fields of all frames stand under each other.
constexpr std::initializer_list<QStringView> TwoPairs = {u"Modo de Pagamento:",
                                                         u"Modo de Pagamento:"};

}  // namespace

frmReposicao::frmReposicao()
    : AccountScreen(u"frmReposicao"_s),
      Text3(forms::displayBox(u"Text3"_s)),
      Text4(forms::displayBox(u"Text4"_s)),
      Text7(forms::textBox(u"Text7"_s, format::Date)),
      Debito(forms::textBox(u"Debito"_s, format::Money)),
      DataCombo1(new forms::DataCombo(u"DataCombo1"_s)),
      Command2(new forms::Button(u"Command2"_s, u"Indicar Familiar"_s)) {
    Command2->setKey(u"Alt+I"_s);
    Command2->setEnabled(false);
    addPersonRow();
    layOut(u"Correção"_s, u"Correção da conta corrente do associado, sem cálculo."_s,
           {propertiesFrame(), resultFrame()}, {Command3, Command4});
    bindControls();
    DataCombo1->onLostFocus = [this] { DataCombo1_LostFocus(); };
    Debito->onGotFocus = [this] { Debito->SelectAll(); };
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Command2_Click(); };
    forms::tabThrough({No_Kor, Command1, Command2, Text7, DataCombo1, DataCombo3, Debito, Credito,
                       Text1, Command3, Command4});
}

void frmReposicao::bindControls() {
    DataCombo1->setList(environment::dtZelmars::instance().Recordsets(u"msRubricas"_s),
                        u"completo"_s, u"rubrica_id"_s);
    forms::bindAll(Adodc1, {{DataCombo1, u"rubrica_id"_s},
                            {Text3, u"codABC"_s},
                            {Text7, u"data"_s},
                            {Debito, u"debito"_s}});
}

void frmReposicao::addPersonRow() {
    forms::addRow(beneficiary(), 1, u"Familiar:"_s, {Text3, Text4, Command2});
    Text3->setFixedWidth(No_Kor->width());
    Text4->setAccessibleName(u"Nome do familiar"_s);
}

QWidget* frmReposicao::propertiesFrame() {
    auto* frame = new forms::Frame(u"Frame2"_s, u"Propriedades do Lançamento:"_s);
    QGridLayout* grid = forms::pairsIn(frame, TwoPairs);
    addPair(grid, 0, 0, u"&Data:"_s, Text7);
    addPair(grid, 0, 1, u"&Rúbrica:"_s, DataCombo1);
    addPair(grid, 1, 0, u"Tipo:"_s, Text8);
    addPair(grid, 1, 1, u"&Modo de Pagamento:"_s, DataCombo3);
    for (forms::TextBox* box : {Text7, Text8})
        box->setFixedWidth(forms::widthFor(box, u"00-00-00000"));
    grid->setColumnStretch(1, 0);
    return frame;
}

QWidget* frmReposicao::resultFrame() {
    auto* frame = new forms::Frame(u"Frame3"_s, u"Resultado do Lançamento:"_s);
    QGridLayout* grid = forms::pairsIn(frame, TwoPairs);
    addPair(grid, 0, 0, u"Dé&bito:"_s, Debito);
    addPair(grid, 0, 1, u"Crédi&to:"_s, Credito);
    return frame;
}

void frmReposicao::showReadOnly(const ado::RecordsetPtr& rows) {
    AccountScreen::showReadOnly(rows);
    Text4->bind(Adodc1, u"familiar"_s);
    forms::setBackColor({Text3, Text4}, forms::BackColor::Window);
    Command2->hide();
}

/// A mode of payment is not preset.
void frmReposicao::setDefaults() {
    Text7->setValue(core::fromDate(core::today()));
    Text8->setText(data::tipo::Reposition.toString());
}

void frmReposicao::takeMember(qint32 socio_id, const QString& nome) {
    AccountScreen::takeMember(socio_id, nome);
    forms::setBackColor({Text3, Text4}, forms::BackColor::Window);
    Command2->setEnabled(true);
}

QWidget* frmReposicao::fieldNamedBy(const QString& text) const {
    if (text.contains("associada a um familiar"_L1))
        return Text3->Text().isEmpty() ? static_cast<QWidget*>(Command2) : DataCombo1;
    if (text.contains(u"para o débito"_s) && Debito->Text().isEmpty()) return Debito;
    if (text.contains("data do registo"_L1)) return Text7;
    return AccountScreen::fieldNamedBy(text);
}

void frmReposicao::clearMember() {
    AccountScreen::clearMember();
    forms::greyOut({Text3, Text4});
    Command2->setEnabled(false);
    Familia_ID = 0;
}

com::Object frmReposicao::openMemberFile() {
    const com::Object file = com::createObject(u"Tiqueta.General"_s);
    file.call(u"Login"_s,
              {u"MSAccess"_s, QVariant::fromValue(environment::dtZelmars::instance().MSAccess())});
    return file;
}

/// Intentional: whether the member is enrolled is not tested. A search given up leaves no member,
/// with the number and the name of the former one still shown.
void frmReposicao::Command1_Click() {
    forms::handlePlainly([this] {
        const qint32 id = core::toLong(openMemberFile().call(u"FindSocios"_s));
        if (id == 0) {
            Socio_ID = 0;
            return;
        }
        const QString nome = core::toText(data::ofMember(id, u"nome"_s));
        No_Kor->setText(core::toText(data::ofMember(id, u"no_kor"_s)));
        takeMember(id, nome);
        noteChoice();
        Command2->setFocus(Qt::TabFocusReason);
    });
}

void frmReposicao::Command2_Click() {
    Familia_ID = openMemberFile().call(u"EscolherFamiliar"_s, {Socio_ID});
    if (core::compareNumbers(Familia_ID, 0) == 0) return;
    // A null leaves the control as it is.
    for (const auto& [box, column] : {std::pair(Text3, u"codABC"_s), std::pair(Text4, u"nome"_s)}) {
        const QVariant value = data::ofPerson(Familia_ID, column);
        if (!core::isNull(value)) box->setText(core::toText(value));
    }
    noteChoice();
    Text7->setFocus(Qt::TabFocusReason);
}

/// Without a rubric the row holds 0, also when nothing was wiped.
void frmReposicao::DataCombo1_LostFocus() {
    if (bShowing() || !DataCombo1->Text().isEmpty()) return;
    core::passingOver([this] { DataCombo1->setBoundText(0); });
}

void frmReposicao::post() {
    const Reposition reposition{.record = Adodc1->Recordset(),
                                .socio_id = Socio_ID,
                                .caption = Caption(),
                                .rubric = DataCombo1->Text(),
                                .personCode = Text3->Text(),
                                .memberNumber = No_Kor->Text(),
                                .debit = Debito->Text(),
                                .credit = Credito->Text()};
    if (postReposition(reposition, operation)) return Unload();
    if (operation.isRegistered) lockFields();
}

}  // namespace receipts
