// SPDX-License-Identifier: MIT
// Controls and layout of the entry screen.
#include <QGridLayout>
#include <QLabel>
#include <QScreen>

#include "data/Codes.h"
#include "entry/frmMovimentos.h"
#include "platform/core/Format.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace entry {

using forms::addPair;
using forms::addRow;
using forms::displayBox;
using forms::pairsIn;
using forms::textBox;
using forms::TextBox;
using forms::widthFor;
namespace format = core::format;

namespace {

/// Fields of all frames stand under each other.
constexpr std::initializer_list<QStringView> OnePair = {u"Modo de Pagamento:"};
constexpr std::initializer_list<QStringView> ThreePairs = {u"Modo de Pagamento:",
                                                           u"Comparticipação:", u"Saldo Plafond:"};

}  // namespace

void frmMovimentos::makeControls() {
    No_Kor = textBox(u"No_Kor"_s, format::Number);
    Text2 = displayBox(u"Text2"_s);
    Text3 = displayBox(u"Text3"_s);
    Text4 = displayBox(u"Text4"_s);
    Command1 = new forms::Button(u"Command1"_s, u"&Procurar Sócio"_s);
    Command2 = new forms::Button(u"Command2"_s, u"&Indicar Familiar"_s);
    Command2->setEnabled(false);

    Text1 = textBox(u"Text1"_s, format::Date);
    Text5 = textBox(u"Text5"_s, format::Number);
    Text6 = textBox(u"Text6"_s, format::Money);
    Text9 = textBox(u"Text9"_s, format::Money);
    Text11 = textBox(u"Text11"_s, format::Rate);
    Text10 = displayBox(u"Text10"_s, format::Amount);
    Text12 = textBox(u"Text12"_s, format::Number);
    DataCombo4 = new forms::DataCombo(u"DataCombo4"_s);

    Text7 = displayBox(u"Text7"_s, format::Date);
    Text8 = displayBox(u"Text8"_s);
    DataCombo1 = new forms::DataCombo(u"DataCombo1"_s);
    DataCombo2 = new forms::DataCombo(u"DataCombo2"_s);

    Incidencia = displayBox(u"Incidencia"_s, format::Money);
    Comparticipacao = displayBox(u"Comparticipacao"_s, format::Money);
    LimiteAplicavel = displayBox(u"LimiteAplicavel"_s, format::Money);
    SaldoCC = displayBox(u"SaldoCC"_s, format::Money);
    Iliquido = displayBox(u"Iliquido"_s, format::Money);
    SaldoPlafond = displayBox(u"SaldoPlafond"_s, format::Money);
    Credito = displayBox(u"Credito"_s, format::Money);
    Debito = displayBox(u"Debito"_s, format::Money);
    Liquido = displayBox(u"Liquido"_s, format::Money);

    DataCombo3 = new forms::DataCombo(u"DataCombo3"_s);
    Command5 = new forms::Button(u"Command5"_s, u"&Ensaio"_s);
    // A second key, for one finger.
    Command5->grabShortcut(QKeySequence(Qt::Key_F9));
    Command5->setToolTip(u"F9"_s);
    Command6 = new forms::Button(u"Command6"_s, u"Anular"_s);
    Command6->setKey(u"Alt+A"_s);
    Command6->hide();
}

QWidget* frmMovimentos::beneficiaryFrame() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Identificação do Beneficiário:"_s);
    QGridLayout* grid = pairsIn(frame, OnePair);
    addRow(grid, 0, u"Número &KOR:"_s, {No_Kor, Text2, Command1}, u"Label1"_s);
    addRow(grid, 1, u"Familiar:"_s, {Text3, Text4, Command2}, u"Label3"_s);
    for (TextBox* code : {No_Kor, Text3}) code->setFixedWidth(widthFor(code, u"0000000000"));
    Text2->setAccessibleName(u"Nome do sócio"_s);
    Text4->setAccessibleName(u"Nome do familiar"_s);
    // 6375 twips, fifteen to the pixel; less where that would be most of the display.
    const int nameWidth = std::min(425, screen()->availableSize().width() / 3);
    Text2->setMinimumWidth(nameWidth);
    Text4->setMinimumWidth(nameWidth);
    grid->setColumnStretch(2, 1);
    return frame;
}

QWidget* frmMovimentos::documentFrame() {
    auto* frame = new forms::Frame(u"Frame2"_s, u"Documento:"_s);
    QGridLayout* grid = pairsIn(frame, ThreePairs);
    addPair(grid, 0, 0, u"&Data:"_s, Text1);
    addPair(grid, 0, 1, u"&Nº Documento:"_s, Text5);
    addPair(grid, 0, 2, u"Va&lor Euros:"_s, Text6);
    Label19 = addPair(grid, 1, 0, u"Rece&bido Euros:"_s, Text9, u"Label19"_s);
    addPair(grid, 1, 1, u"Ta&xa IVA:"_s, Text11);
    addPair(grid, 1, 2, u"Imposto IVA:"_s, Text10);
    addPair(grid, 2, 0, u"En&tidade:"_s, DataCombo4, {}, 3);
    addPair(grid, 3, 0, u"Obser&vações:"_s, Text12, {}, 3);
    return frame;
}

QWidget* frmMovimentos::propertiesFrame() {
    auto* frame = new forms::Frame(u"Frame3"_s, u"Propriedades do Lançamento:"_s);
    QGridLayout* grid = pairsIn(frame, OnePair);
    addPair(grid, 0, 0, u"Data:"_s, Text7);
    addPair(grid, 0, 1, u"&Rúbrica:"_s, DataCombo1);
    addPair(grid, 1, 0, u"Tipo:"_s, Text8);
    Label18 = addPair(grid, 1, 1, u"&Hospital:"_s, DataCombo2, u"Label18"_s);
    for (TextBox* box : {Text7, Text8}) box->setFixedWidth(widthFor(box, u"00-00-00000"));
    // The hospital's row keeps its place while it is hidden.
    grid->setColumnMinimumWidth(2, Label18->sizeHint().width());
    grid->setRowMinimumHeight(1, DataCombo2->sizeHint().height());
    grid->setColumnStretch(3, 1);
    Label18->hide();
    DataCombo2->hide();
    return frame;
}

QWidget* frmMovimentos::resultFrame() {
    auto* frame = new forms::Frame(u"Frame4"_s, u"Resultado do Lançamento:"_s);
    keepInSight(frame);
    QGridLayout* grid = pairsIn(frame, ThreePairs);
    // What will be posted stands out.
    for (TextBox* outcome : {Credito, Debito}) {
        QFont bold = outcome->font();
        bold.setBold(true);
        outcome->setFont(bold);
    }
    addPair(grid, 0, 0, u"Incidência:"_s, Incidencia);
    addPair(grid, 0, 1, u"Comparticipação:"_s, Comparticipacao);
    Label12 = addPair(grid, 0, 2, u"Plafond:"_s, LimiteAplicavel, u"Label12"_s);
    addPair(grid, 1, 0, u"Saldo C.Corrente:"_s, SaldoCC);
    addPair(grid, 1, 1, u"Ilíquido:"_s, Iliquido);
    addPair(grid, 1, 2, u"Saldo Plafond:"_s, SaldoPlafond);
    addPair(grid, 2, 0, u"Crédito:"_s, Credito);
    addPair(grid, 2, 1, u"Débito:"_s, Debito);
    addPair(grid, 2, 2, u"Líquido:"_s, Liquido);
    const int amountWidth = widthFor(Credito, u"(€ 999.999.999,99)");
    for (TextBox* amount : frame->findChildren<TextBox*>()) amount->setMinimumWidth(amountWidth);
    return frame;
}

void frmMovimentos::layOut() {
    auto* foot = new QWidget;
    QGridLayout* below = pairsIn(foot, OnePair);
    below->setContentsMargins(12, 2, 0, 0);
    addRow(below, 0, u"&Modo de Pagamento:"_s, {DataCombo3});
    DataCombo3->setMinimumWidth(widthFor(DataCombo3, data::modo::Widest));
    below->setColumnStretch(2, 1);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    for (forms::Button* button : {Command6, Command5, Command3, Command4})
        buttons->addWidget(button);
    if (forms::isNarrow(this))
        below->addLayout(buttons, 1, 0, 1, 4);
    else
        below->addLayout(buttons, 0, 3);

    QWidget* band = forms::headingBand(
        u"Lançamento de Documentos"_s,
        u"Lançamento no Plano de Saúde de documentos na conta corrente do associado."_s,
        u"Label25"_s, u"Label26"_s, u"Image1"_s);
    band->setObjectName(u"Frame5"_s);
    QVBoxLayout* body = forms::bodyUnder(band, this);
    for (QWidget* part :
         {beneficiaryFrame(), documentFrame(), propertiesFrame(), resultFrame(), foot})
        body->addWidget(part);
    body->addStretch(1);

    // Enter ends by trying the document out, which does no harm; posting wants its own key.
    letEnterGoOn(Command5);
    setTabOrders();
    No_Kor->setFocus();
}

void frmMovimentos::setTabOrders() {
    forms::tabThrough({No_Kor, Command1, Command2, Text1, Text5, Text6, Text9, Text11, DataCombo4,
                       Text12, DataCombo1, DataCombo2, DataCombo3, Command5, Command3, Command6,
                       Command4});
}

}  // namespace entry
