// SPDX-License-Identifier: MIT
#include "masterdata/frmHospitais_record.h"

#include <QGridLayout>

#include "masterdata/frmHospitais.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace masterdata {

using forms::addPair;
using forms::textBox;
using forms::TextBox;

frmHospitais_record::frmHospitais_record()
    : Form(u"frmHospitais_record"_s, u"Hospital"_s),
      Adodc1(new forms::DataControl(u"Adodc1"_s, this)),
      Text1(textBox(u"Text1"_s)),
      Text2(textBox(u"Text2"_s)),
      Text3(textBox(u"Text3"_s)),
      Text4(textBox(u"Text4"_s)),
      Text5(textBox(u"Text5"_s)),
      Text6(textBox(u"Text6"_s)),
      Text7(textBox(u"Text7"_s)),
      Text8(textBox(u"Text8"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&OK"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Cancelar"_s)) {
    layOut();
    forms::bindAll(Adodc1, {{Text7, u"code"_s},
                            {Text1, u"nome"_s},
                            {Text2, u"morada"_s},
                            {Text4, u"code_postal"_s},
                            {Text8, u"localidade"_s},
                            {Text3, u"telefone1"_s},
                            {Text5, u"telefone2"_s},
                            {Text6, u"fax"_s}});
    connectHandlers();
}

void frmHospitais_record::layOut() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Identificação:"_s);
    QGridLayout* grid = forms::pairsIn(frame, {u"Cod. Postal:", u"Localidade:"});
    addPair(grid, 0, 0, u"Có&digo:"_s, Text7);
    addPair(grid, 1, 0, u"&Nome:"_s, Text1, {}, 2);
    addPair(grid, 2, 0, u"&Morada:"_s, Text2, {}, 2);
    addPair(grid, 3, 0, u"Cod. &Postal:"_s, Text4);
    addPair(grid, 3, 1, u"&Localidade:"_s, Text8);
    addPair(grid, 4, 0, u"Telefone &1:"_s, Text3);
    addPair(grid, 4, 1, u"Telefone &2:"_s, Text5);
    addPair(grid, 5, 0, u"&Fax:"_s, Text6);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Hospital"_s, u"Como o hospital aparece nas listas e nos mapas."_s,
                           u"Label25"_s, u"Label26"_s, u"Image1"_s),
        this);
    body->addWidget(frame);
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    foot->addWidget(Command1);
    foot->addWidget(Command2);
    body->addLayout(foot);
    setMinimumWidth(90 * fontMetrics().averageCharWidth());
    forms::tabThrough({Text7, Text1, Text2, Text4, Text8, Text3, Text5, Text6, Command1, Command2});
    Text7->setFocus();
}

void frmHospitais_record::connectHandlers() {
    // Intentional: the code alone is not limited.
    for (TextBox* box : {Text1, Text3, Text4, Text5, Text6, Text8})
        connect(box, &QLineEdit::textChanged, this, &frmHospitais_record::limitFocused);
    Text2->onGotFocus = [this] { limitFocused(); };
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Unload(); };
    // However the screen is left, nobody waits for the row any longer.
    onUnload = [this] { core::passingOver([this] { Adodc1->Recordset()->Close(); }); };
    setCancelButton(Command2);
    letEnterGoOn(Command1);
}

/// Intentional: of the box that has the focus, whichever changed. None has it before the screen is
/// up, though boxes are filled by then.
void frmHospitais_record::limitFocused() {
    if (!isVisible()) return;
    core::passingOver([this] {
        if (auto* box = qobject_cast<TextBox*>(ActiveControl())) box->limitToColumn();
    });
}

/// Intentional: a save that fails is told in the database's own words, and the typing is lost.
void frmHospitais_record::Command1_Click() {
    const ado::RecordsetPtr rows = Adodc1->Recordset();
    try {
        rows->Update();
    } catch (const core::Failure& failure) {
        core::MsgBox(failure.text());
    }
    Unload();
    core::passingOver([] {
        if (forms::DefaultInstance<frmHospitais>::isLoaded())
            forms::DefaultInstance<frmHospitais>::get().Adodc1->Recordset()->Requery();
    });
}

}  // namespace masterdata
