// SPDX-License-Identifier: MIT
#include "masterdata/frmPlafonds_record.h"

#include <QGridLayout>
#include <QLabel>

#include "data/Rubrics.h"
#include "masterdata/frmPlafonds_Main.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace masterdata {

using forms::addPair;
using forms::textBox;
using forms::TextBox;
namespace format = core::format;

namespace {

/// Two boxes on one column: what is typed into one stands in the other at once.
void follow(TextBox* one, TextBox* other) {
    const auto tell = [](TextBox* from, TextBox* to) {
        QObject::connect(from, &QLineEdit::textEdited, to,
                         [to](const QString& text) { to->QLineEdit::setText(text); });
        // What is typed may be the value that the row has already, and then nothing else tells.
        QObject::connect(from, &QLineEdit::editingFinished, to,
                         [to] { emit to->DataSource()->fieldChanged(to->DataField()); });
    };
    tell(one, other);
    tell(other, one);
}

/// A heading and two boxes below it, as columns of a frame.
void addGroup(QGridLayout* grid, int column, const QString& heading, const QString& member,
              TextBox* memberBox, const QString& relative, TextBox* relativeBox) {
    grid->addWidget(new QLabel(heading), 0, 2 * column, 1, 2);
    addPair(grid, 1, column, member, memberBox);
    addPair(grid, 2, column, relative, relativeBox);
    // The same words stand under each heading.
    for (TextBox* box : {memberBox, relativeBox})
        box->setAccessibleName(heading + u' ' + box->accessibleName());
}

}  // namespace

frmPlafonds_record::frmPlafonds_record()
    : Form(u"frmPlafonds_record"_s, u"Rúbrica"_s),
      Adodc1(new forms::DataControl(u"Adodc1"_s, this)),
      Text1(textBox(u"Text1"_s)),
      Text2(textBox(u"Text2"_s)),
      Text3(textBox(u"Text3"_s, format::Fraction)),
      Text4(textBox(u"Text4"_s, format::Money)),
      Text5(textBox(u"Text5"_s, format::Money)),
      Text6(textBox(u"Text6"_s)),
      Text7(textBox(u"Text7"_s, format::Money)),
      Text8(textBox(u"Text8"_s)),
      Text9(textBox(u"Text9"_s, format::Money)),
      Text10(textBox(u"Text10"_s, format::Money)),
      Text11(textBox(u"Text11"_s, format::Money)),
      Text12(textBox(u"Text12"_s, format::Money)),
      Text13(textBox(u"Text13"_s, format::Money)),
      Text14(textBox(u"Text14"_s, format::Money)),
      Text15(textBox(u"Text15"_s, format::Money)),
      Text16(textBox(u"Text16"_s, format::Money)),
      Command1(new forms::Button(u"Command1"_s, u"&OK"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Cancelar"_s)) {
    layOut();
    bindControls();
    connectHandlers();
}

void frmPlafonds_record::layOut() {
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Rúbrica"_s,
                           u"A parte que o plano paga de um documento, e os limites dela."_s,
                           u"Label25"_s, u"Label26"_s, u"Image1"_s),
        this);
    for (QWidget* frame : {rubricFrame(), yearFrame(), postingFrame()}) body->addWidget(frame);
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    foot->addWidget(Command1);
    foot->addWidget(Command2);
    body->addLayout(foot);
    forms::tabThrough({Text1, Text2, Text3, Text4, Text5, Text7, Text9, Text14, Text6, Text8,
                       Text13, Text11, Text12, Text10, Text15, Text16, Command1, Command2});
    Text1->setFocus();
}

QWidget* frmPlafonds_record::rubricFrame() {
    auto* frame = new forms::Frame(u"Frame3"_s, {});
    QGridLayout* grid = forms::pairsIn(frame, {u"Percentagem de Comparticipação:", u"Descrição:"});
    addPair(grid, 0, 0, u"Nº &Rúbrica:"_s, Text1);
    addPair(grid, 0, 1, u"&Descrição:"_s, Text2);
    addPair(grid, 1, 0, u"&Percentagem de Comparticipação:"_s, Text3);
    Text2->setMinimumWidth(forms::widthFor(Text2, u"Consultas de especialidade e tratamentos"));
    return frame;
}

QWidget* frmPlafonds_record::yearFrame() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Limites para o Total da Anuidade:"_s);
    QGridLayout* grid = forms::pairsIn(
        frame, {u"Nº Máx. por Familiar:", u"Conj. Familiares:", u"Conj. Familiares:"});
    addPair(grid, 0, 0, u"A&gregado:"_s, Text4);
    addPair(grid, 0, 1, u"&Sócio:"_s, Text5);
    addPair(grid, 0, 2, u"&Familiar:"_s, Text7);
    addPair(grid, 1, 0, u"Co&nj. Familiares:"_s, Text9);
    addPair(grid, 1, 1, u"Fran&quia:"_s, Text14);
    addPair(grid, 2, 0, u"Nº &Máx. por Sócio:"_s, Text6);
    addPair(grid, 2, 1, u"Nº Máx. por Famili&ar:"_s, Text8);
    return frame;
}

QWidget* frmPlafonds_record::postingFrame() {
    auto* frame = new forms::Frame(u"Frame2"_s, u"Limites por Lançamento"_s);
    QGridLayout* grid =
        forms::pairsIn(frame, {u"Máx. por Familiar:", u"Min por Familiar:", u"Familiar:"});
    addGroup(grid, 0, u"Comparticipação Máxima:"_s, u"Máx. por Sócio:"_s, Text13,
             u"Máx por Familiar:"_s, Text11);
    addGroup(grid, 1, u"Valor Mínimo de Documento a Comparticipar:"_s, u"Min por Sócio:"_s, Text12,
             u"Min por Familiar:"_s, Text10);
    addGroup(grid, 2, u"Franquia por Lançamento:"_s, u"Sócio:"_s, Text15, u"Familiar:"_s, Text16);
    return frame;
}

void frmPlafonds_record::bindControls() {
    forms::bindAll(Adodc1, {{Text1, u"code"_s},
                            {Text2, u"descrit"_s},
                            {Text3, u"percent"_s},
                            {Text4, u"agregado"_s},
                            {Text5, u"socio"_s},
                            {Text7, u"familiar"_s},
                            {Text9, u"total_familia"_s},
                            {Text14, u"franquia"_s},
                            {Text6, u"nomax_recibos_socio"_s},
                            {Text8, u"nomax_recibos_familiar"_s},
                            {Text13, u"socio_max_lan"_s},
                            {Text11, u"familiar_max_lan"_s},
                            {Text12, u"socio_min_lan"_s},
                            {Text15, u"socio_min_lan"_s},
                            {Text10, u"familiar_min_lan"_s},
                            {Text16, u"familiar_min_lan"_s}});
    follow(Text12, Text15);
    follow(Text10, Text16);
}

void frmPlafonds_record::connectHandlers() {
    for (TextBox* box : {Text1, Text3, Text4, Text5, Text6, Text7, Text8, Text9, Text10, Text11,
                         Text12, Text13, Text14})
        box->onGotFocus = [box] { box->SelectAll(); };
    Text2->onGotFocus = [this] {
        Text2->limitToColumn();
        Text2->SelectAll();
    };
    for (TextBox* box :
         {Text4, Text5, Text6, Text7, Text8, Text9, Text10, Text11, Text12, Text13, Text14})
        box->onValidate = [box](bool&) { box->storeNullIfEmpty(); };
    Text3->onValidate = [this](bool& cancel) { Text3_Validate(cancel); };
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Unload(); };
    // However the screen is left, nobody waits for the row any longer.
    onUnload = [this] { core::passingOver([this] { Adodc1->Recordset()->Close(); }); };
    setCancelButton(Command2);
    letEnterGoOn(Command1);
}

/// Intentional: an empty percentage cannot be left by Tab at all.
void frmPlafonds_record::Text3_Validate(bool& cancel) {
    Text3->storeNullIfEmpty();
    if (!core::parseNumber(Text3->Text())) cancel = true;
}

void frmPlafonds_record::Command1_Click() {
    if (Text3->Text().isEmpty()) {
        core::MsgBox(u"Tem de indicar um valor para a percentagem."_s, core::Icon::Information);
        return;
    }
    if (!data::isPercent(core::toDouble(Text3->Value()))) {
        core::MsgBox(u"Tem de indicar um valor entre 0 e 1 para a percentagem."_s,
                     core::Icon::Information);
        return;
    }
    // Intentional: nobody is told of what fails from here.
    const ado::RecordsetPtr rows = Adodc1->Recordset();
    auto& group = forms::DefaultInstance<frmPlafonds_Main>::get();
    core::passingOver([&] {
        rows->setCollect(u"rubrica_id_main"_s, group.Adodc1->Recordset()->Collect(u"rubrica_id"_s));
    });
    core::passingOver([&] { rows->Update(); });
    Unload();
    core::passingOver([&] {
        if (group.Adodc2->Recordset()) group.Adodc2->Recordset()->Requery();
    });
}

}  // namespace masterdata
