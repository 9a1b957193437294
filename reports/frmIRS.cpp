// SPDX-License-Identifier: MIT
#include "reports/frmIRS.h"

#include <QGridLayout>
#include <QLabel>

#include "boundary/environment/dtZelmars.h"
#include "data/modDlookup.h"
#include "platform/core/Clock.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "platform/printing/DataReport.h"
#include "reports/ReportRows.h"
#include "reports/TaxQuery.h"
#include "reports/TaxReport.h"

using namespace Qt::StringLiterals;

namespace reports {

using core::Icon;
using core::MsgBox;
using forms::BackColor;
using forms::ListBox;

namespace {

constexpr int RowsOfLists = 6;

const QString Positions =
    u"select *, descrit + ' - ' + grau as completo from tbSocios_Familias_CodeABC"_s;

ado::RecordsetPtr opened(const QString& query) {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(query, environment::dtZelmars::instance().MSAccess());
    return rows;
}

void fill(ListBox* list, const QString& query, const QString& column) {
    const ado::RecordsetPtr rows = opened(query);
    for (; !rows->atEnd(); rows->MoveNext()) list->AddItem(core::toText(rows->Collect(column)));
    rows->Close();
}

}  // namespace

frmIRS::frmIRS()
    : Form(u"frmIRS"_s, u"Declaração de IRS"_s),
      Option1(
          new forms::OptionButton(u"Option1"_s, u"Imprimir declarções de todos os Associados;"_s)),
      Option2(new forms::OptionButton(u"Option2"_s,
                                      u"Imprimir declaração de um determinado Associado;"_s)),
      No_Kor(forms::textBox(u"No_Kor"_s, core::format::Number)),
      Text2(forms::displayBox(u"Text2"_s)),
      List1(new ListBox(u"List1"_s, ListBox::Choice::One)),
      List2(new ListBox(u"List2"_s, ListBox::Choice::Several)),
      Command3(new forms::Button(u"Command3"_s, u"&Imprimir"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&Sair"_s)) {
    layOut();
    connectHandlers();
    Option1->setChecked(true);
}

QWidget* frmIRS::beneficiaryFrame() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Beneficiário(s):"_s);
    auto* grid = new QGridLayout(frame);
    grid->addWidget(Option1, 0, 0, 1, 3);
    grid->addWidget(Option2, 1, 0, 1, 3);
    Label4 = forms::fieldLabel(u"&Número de Empresa:"_s, No_Kor, u"Label4"_s);
    grid->addWidget(Label4, 2, 0);
    grid->addWidget(No_Kor, 2, 1);
    grid->addWidget(Text2, 2, 2);
    grid->setColumnStretch(2, 1);
    No_Kor->setFixedWidth(forms::widthFor(No_Kor, u"000000000000"));
    Text2->setAccessibleName(u"Nome do associado"_s);
    Text2->setMinimumWidth(Text2->fontMetrics().averageCharWidth() * 45);
    return frame;
}

QWidget* frmIRS::familyFrame() {
    auto* frame = new forms::Frame(u"Frame2"_s, u"Agregado Familiar:"_s);
    auto* column = new QVBoxLayout(frame);
    column->addWidget(List2);
    List2->setAccessibleName(u"Agregado familiar"_s);
    List2->setToolTip(u"Espaço escolhe ou deixa de escolher; Ctrl+A escolhe todos."_s);
    return frame;
}

void frmIRS::layOut() {
    auto* year = new QVBoxLayout;
    year->addWidget(forms::fieldLabel(u"&Ano de referência:"_s, List1, u"Label1"_s));
    year->addWidget(List1);
    for (ListBox* list : {List1, List2})
        list->setMinimumHeight((list->fontMetrics().height() + 4) * RowsOfLists);
    List1->setFixedWidth(forms::widthFor(List1, u"Ano de referência:"));
    auto* lists = new QHBoxLayout;
    lists->addLayout(year);
    lists->addWidget(familyFrame(), 1);

    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    foot->addWidget(Command3);
    foot->addWidget(Command1);

    QVBoxLayout* body =
        forms::bodyUnder(forms::headingBand(u"Declaração para efeitos de IRS"_s,
                                            u"Imprimir de acordo com as seguintes restrições:"_s,
                                            u"Label3"_s, u"Label5"_s, u"Image1"_s),
                         this);
    body->addWidget(beneficiaryFrame());
    body->addLayout(lists, 1);
    body->addLayout(foot);
    Command3->setDefault(true);
    forms::tabThrough({Option1, Option2, No_Kor, List1, List2, Command3, Command1});
    Option1->setFocus();
}

void frmIRS::connectHandlers() {
    onLoad = [this] { Form_Load(); };
    onUnload = [this] {
        List1->Clear();
        List2->Clear();
    };
    connect(Option1, &QRadioButton::toggled, this,
            [this](bool isOn) { isOn ? Option1_Click() : Option2_Click(); });
    No_Kor->onGotFocus = [this] { No_Kor->SelectAll(); };
    No_Kor->onValidate = [this](bool& cancel) { No_Kor_Validate(cancel); };
    Command3->onClick = [this] { Command3_Click(); };
    Command1->onClick = [this] { Unload(); };
    setCancelButton(Command1);
    onBoxClosed = [this](const QString& text) { return fieldNamedBy(text); };
}

void frmIRS::Form_Load() {
    fill(List1,
         u"SELECT tbZelmar_Movimentos_Historico.ano From tbZelmar_Movimentos_Historico GROUP BY "
         "tbZelmar_Movimentos_Historico.ano"_s,
         u"ano"_s);
    List1->sortItems();
    // Intentional: a year that can be chosen and prints nothing.
    if (List1->ListCount() == 0) List1->AddItem(QString::number(core::today().year() - 1));
    fill(List2, Positions + u" order by descrit"_s, u"completo"_s);
}

void frmIRS::Option1_Click() {
    for (QWidget* each : std::initializer_list<QWidget*>{Label4, No_Kor, Text2})
        each->setEnabled(false);
    for (forms::TextBox* box : {No_Kor, Text2}) box->setBackColor(BackColor::Menu);
}

void frmIRS::Option2_Click() {
    for (QWidget* each : std::initializer_list<QWidget*>{Label4, No_Kor}) each->setEnabled(true);
    for (forms::TextBox* box : {No_Kor, Text2}) box->setBackColor(BackColor::Window);
}

/// A number is good when it has history, in any year.
void frmIRS::No_Kor_Validate(bool& cancel) {
    if (No_Kor->Text().isEmpty()) return Text2->Clear();
    const ado::RecordsetPtr member = opened(
        u"select * from tbZelmar_movimentos_historico where no_kor ='"_s + No_Kor->Text() + u'\'');
    if (member->atEnd()) {
        cancel = true;
        MsgBox(u"Número de Empresa não existe!"_s, Icon::Information);
        socio_id_ = 0;
    } else {
        Text2->setText(core::toText(member->Collect(u"nome"_s)));
        socio_id_ = core::toLong(member->Collect(u"socio_id"_s));
    }
    member->Close();
}

QString frmIRS::missing() const {
    if (Option2->isChecked() && No_Kor->Text().isEmpty())
        return u"Tem de indicar um Associado para a declaração de IRS."_s;
    if (List1->chosen().isEmpty()) return u"Tem de indicar um ano de processamento."_s;
    if (List2->chosen().isEmpty())
        return u"Tem de indicar pelo menos um elemento do agregado familiar."_s;
    return {};
}

QWidget* frmIRS::fieldNamedBy(const QString& text) const {
    if (text.contains("um Associado"_L1)) return No_Kor;
    if (text.contains("um ano"_L1)) return List1;
    return text.contains("do agregado"_L1) ? List2 : nullptr;
}

QStringList frmIRS::codesChosen() const {
    QStringList codes;
    for (const QString& position : List2->chosen())
        codes << core::toText(
            data::DLookup(Positions + u" where descrit + ' - ' + grau = '"_s + position + u'\'', {},
                          u"descrit"_s));
    return codes;
}

void frmIRS::Command3_Click() {
    if (const QString text = missing(); !text.isEmpty()) {
        MsgBox(text, Icon::Information);
        return;
    }
    TaxSelection selection{.year = List1->chosen().constFirst(), .codes = codesChosen()};
    if (Option2->isChecked()) selection.socio_id = socio_id_;
    // Intentional: a failure leaves the button disabled, and the way on is "&Sair".
    Command3->setEnabled(false);
    printOrShow(printing::DataReport(prtIRS()), taxQuery(selection), /*isPrinted*/ false);
    Command3->setEnabled(true);
    Command3->setFocus();
}

}  // namespace reports
