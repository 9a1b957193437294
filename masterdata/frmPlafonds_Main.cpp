// SPDX-License-Identifier: MIT
#include "masterdata/frmPlafonds_Main.h"

#include <QCloseEvent>
#include <QGridLayout>

#include "data/RowSets.h"
#include "masterdata/Deletion.h"
#include "masterdata/ListButtons.h"
#include "masterdata/RubricQueries.h"
#include "masterdata/frmPlafonds.h"
#include "masterdata/frmPlafonds_record.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace masterdata {

using forms::addPair;
using forms::textBox;
namespace format = core::format;

namespace {

const QString Key = u"rubrica_id"_s;

}  // namespace

frmPlafonds_Main::frmPlafonds_Main()
    : Form(u"frmPlafonds_Main"_s, u"Rúbricas"_s),
      Adodc1(new forms::DataControl(u"Adodc1"_s, this)),
      Adodc2(new forms::DataControl(u"Adodc2"_s, this)),
      Text1(textBox(u"Text1"_s)),
      Text2(textBox(u"Text2"_s)),
      Text4(textBox(u"Text4"_s, format::Money)),
      Text5(textBox(u"Text5"_s, format::Money)),
      Text7(textBox(u"Text7"_s, format::Money)),
      Text9(textBox(u"Text9"_s, format::Money)),
      DataGrid1(new forms::DataGrid(u"DataGrid1"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&Adicionar"_s)),
      Command2(new forms::Button(u"Command2"_s, u"Alt&erar"_s)),
      Command3(new forms::Button(u"Command3"_s, u"A&pagar"_s)),
      Command4(new forms::Button(u"Command4"_s, u"&Sair"_s)) {
    layOut();
    bindControls();
    for (forms::TextBox* box : {Text4, Text5, Text7, Text9}) {
        box->onGotFocus = [box] { box->SelectAll(); };
        box->onValidate = [box](bool&) { box->storeNullIfEmpty(); };
    }
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Command2_Click(); };
    Command3->onClick = [this] { Command3_Click(); };
    Command4->onClick = [this] { Unload(); };
    // The window's own button and Esc leave it, too.
    onUnload = [this] { save(); };
    letEnterGoOn(nullptr);
}

void frmPlafonds_Main::layOut() {
    auto* rubric = new forms::Frame(u"Frame1"_s, {});
    QGridLayout* grid = forms::pairsIn(rubric, {u"Conjunto Familiares:", u"Conjunto Familiares:"});
    addPair(grid, 0, 0, u"Nº &Rúbrica:"_s, Text1);
    addPair(grid, 0, 1, u"&Descrição:"_s, Text2);

    auto* limits = new forms::Frame(u"Frame2"_s, u"Limites Máximos do Grupo de Rúbricas:"_s);
    grid = forms::pairsIn(limits, {u"Conjunto Familiares:", u"Conjunto Familiares:"});
    addPair(grid, 0, 0, u"A&gregado:"_s, Text4);
    addPair(grid, 0, 1, u"Sóc&io:"_s, Text5);
    addPair(grid, 1, 0, u"&Familiar:"_s, Text7);
    addPair(grid, 1, 1, u"&Conjunto Familiares:"_s, Text9);

    const QString money = format::Money.toString();
    DataGrid1->setAccessibleName(u"Rubricas do grupo"_s);
    DataGrid1->setColumns({{u"code"_s, u"Código"_s, {}, 10},
                           {u"descrit"_s, u"Descrição"_s, {}, 38},
                           {u"percent"_s, u"Percent."_s, format::Fraction.toString(), 10, true},
                           {u"agregado"_s, u"Agregado"_s, money, 16, true},
                           {u"socio"_s, u"Sócio"_s, money, 16, true},
                           {u"familiar"_s, u"Familiar"_s, money, 16, true},
                           {u"total_familia"_s, u"T. Familia"_s, money, 16, true}});
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Rúbricas"_s,
                           u"Um grupo de rubricas: os seus limites anuais e as suas rubricas."_s,
                           u"Label25"_s, u"Label26"_s, u"Image1"_s),
        this);
    body->addWidget(rubric);
    body->addWidget(limits);
    body->addLayout(listWithButtons(DataGrid1, {Command1, Command2, Command3, Command4}));
    resize(150 * fontMetrics().averageCharWidth(), 36 * fontMetrics().height());
    forms::tabThrough({Text1, Text2, Text4, Text5, Text7, Text9, DataGrid1, Command1, Command2,
                       Command3, Command4});
    Text1->setFocus();
}

void frmPlafonds_Main::bindControls() {
    forms::bindAll(Adodc1, {{Text1, u"code"_s},
                            {Text2, u"descrit"_s},
                            {Text4, u"agregado"_s},
                            {Text5, u"socio"_s},
                            {Text7, u"familiar"_s},
                            {Text9, u"total_familia"_s}});
}

void frmPlafonds_Main::setChildren(const ado::RecordsetPtr& children) {
    Adodc2->setRecordset(children);
    DataGrid1->setRecordset(children);
}

ado::Recordset& frmPlafonds_Main::rubric() const {
    if (!Adodc1->Recordset())
        throw core::Failure(core::NoCurrentRow, u"Não foi possível abrir a rubrica."_s);
    return *Adodc1->Recordset();
}

/// False where what is typed is refused, which was said then.
bool frmPlafonds_Main::leaveField() {
    auto* field = dynamic_cast<forms::Validating*>(ActiveControl());
    return !field || field->leave();
}

// Leaving is saving, also by Esc and by the window's own button: a field that refuses what is typed
// holds the screen as it holds the focus.
void frmPlafonds_Main::reject() {
    if (leaveField()) Form::reject();
}

void frmPlafonds_Main::closeEvent(QCloseEvent* event) {
    if (leaveField())
        Form::closeEvent(event);
    else
        event->ignore();
}

/// Intentional: nobody is told of what fails here.
void frmPlafonds_Main::save() {
    core::passingOver([this] { rubric().Update(); });
    core::passingOver([this] { rubric().Close(); });
    core::passingOver([] {
        if (forms::DefaultInstance<frmPlafonds>::isLoaded())
            forms::DefaultInstance<frmPlafonds>::get().Adodc1->Recordset()->Requery();
    });
}

/// A rubric that was never saved has no key yet, which its children need.
void frmPlafonds_Main::Command1_Click() {
    ado::Recordset& main = rubric();
    if (core::isNull(main.Collect(Key))) core::passingOver([&] { main.Update(); });
    keyOf(*Adodc1, Key);
    auto& screen = forms::DefaultInstance<frmPlafonds_record>::get();
    const ado::RecordsetPtr rows = data::openToWrite(rubricQuery(0));
    screen.Adodc1->setRecordset(rows);
    rows->AddNew();
    screen.ShowModal();
}

void frmPlafonds_Main::Command2_Click() {
    const qint32 id = keyOf(*Adodc2, Key);
    auto& screen = forms::DefaultInstance<frmPlafonds_record>::get();
    screen.Adodc1->setRecordset(data::openToWrite(rubricQuery(id)));
    screen.ShowModal();
}

void frmPlafonds_Main::Command3_Click() {
    if (deleteAsked(rubricDeletion(keyOf(*Adodc2, Key)))) Adodc2->Recordset()->Requery();
}

}  // namespace masterdata
