// SPDX-License-Identifier: MIT
#include "masterdata/frmPlafonds.h"

#include "data/RowSets.h"
#include "masterdata/Deletion.h"
#include "masterdata/ListButtons.h"
#include "masterdata/RubricQueries.h"
#include "masterdata/frmPlafonds_Main.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace masterdata {

namespace {

const QString Key = u"rubrica_id"_s;

}  // namespace

frmPlafonds::frmPlafonds()
    : Form(u"frmPlafonds"_s, u"Tabela de Rubricas e Plafonds"_s),
      Adodc1(new forms::DataControl(u"Adodc1"_s, this)),
      DataGrid1(new forms::DataGrid(u"DataGrid1"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&Sair"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Adicionar"_s)),
      Command3(new forms::Button(u"Command3"_s, u"Al&terar"_s)),
      Command4(new forms::Button(u"Command4"_s, u"A&pagar"_s)) {
    layOut();
    setCancelButton(Command1);
    Command1->onClick = [this] { Unload(); };
    Command2->onClick = [this] { Command2_Click(); };
    Command3->onClick = [this] { Command3_Click(); };
    Command4->onClick = [this] { Command4_Click(); };
}

void frmPlafonds::layOut() {
    const QString money = core::format::Money.toString();
    DataGrid1->setAccessibleName(u"Grupos de rubricas"_s);
    DataGrid1->setColumns({{u"code"_s, u"Nº"_s, {}, 8},
                           {u"descrit"_s, u"Descrição"_s, {}, 44},
                           {u"agregado"_s, u"Agregado"_s, money, 16, true},
                           {u"socio"_s, u"Associado"_s, money, 16, true},
                           {u"familiar"_s, u"Familiar"_s, money, 16, true},
                           {u"total_familia"_s, u"Familia"_s, money, 16, true}});
    forms::bodyUnder(forms::headingBand(u"Tabela de Rubricas e Plafonds"_s,
                                        u"Grupos de rubricas, com os limites anuais de cada um."_s,
                                        u"Label25"_s, u"Label26"_s, u"Image1"_s),
                     this)
        ->addLayout(listWithButtons(DataGrid1, {Command2, Command3, Command4, Command1}));
    resize(130 * fontMetrics().averageCharWidth(), 30 * fontMetrics().height());
    DataGrid1->setFocus();
}

void frmPlafonds::setRows(const ado::RecordsetPtr& rubrics) {
    Adodc1->setRecordset(rubrics);
    DataGrid1->setRecordset(rubrics);
}

/// Intentional: whatever fails is passed over, so that the screen also opens from an empty list.
void frmPlafonds::Command2_Click() {
    auto& screen = forms::DefaultInstance<frmPlafonds_Main>::get();
    core::passingOver([&] {
        const ado::RecordsetPtr rows = data::openToWrite(rubricQuery(0));
        screen.Adodc1->setRecordset(rows);
        rows->AddNew();
    });
    core::passingOver([&] { screen.ShowModal(); });
}

void frmPlafonds::Command3_Click() {
    const qint32 id = keyOf(*Adodc1, Key);
    auto& screen = forms::DefaultInstance<frmPlafonds_Main>::get();
    screen.Adodc1->setRecordset(data::openToWrite(rubricQuery(id)));
    screen.setChildren(data::openToRead(childrenQuery(id) + u" order by code"_s));
    screen.ShowModal();
}

/// Intentional: what is related to the children alone keeps nothing.
void frmPlafonds::Command4_Click() {
    const qint32 id = keyOf(*Adodc1, Key);
    Deletion deletion = rubricDeletion(id);
    deletion.children =
        u"Select * from tbZelmar_Plafonds where rubrica_id_main = "_s + QString::number(id);
    if (deleteAsked(deletion)) Adodc1->Recordset()->Requery();
}

}  // namespace masterdata
