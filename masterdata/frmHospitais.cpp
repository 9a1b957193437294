// SPDX-License-Identifier: MIT
#include "masterdata/frmHospitais.h"

#include "data/RowSets.h"
#include "masterdata/Deletion.h"
#include "masterdata/ListButtons.h"
#include "masterdata/frmHospitais_record.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace masterdata {

namespace {

const QString Key = u"hospital_id"_s;

/// One hospital; with 0 none, which gives an empty set that rows can be added to.
QString hospitalQuery(qint32 hospital_id) {
    return u"SELECT * From tbHospitais WHERE hospital_id = "_s + QString::number(hospital_id);
}

}  // namespace

frmHospitais::frmHospitais()
    : Form(u"frmHospitais"_s, u"Tabela de Hospitais"_s),
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

void frmHospitais::layOut() {
    DataGrid1->setAccessibleName(u"Hospitais"_s);
    DataGrid1->setColumns({{u"code"_s, u"Código"_s, {}, 10},
                           {u"nome"_s, u"Nome"_s, {}, 40},
                           {u"morada"_s, u"Morada"_s, {}, 44},
                           {u"Codigo_Postal"_s, u"Código Postal"_s, {}, 14}});
    forms::bodyUnder(forms::headingBand(u"Tabela de Hospitais"_s,
                                        u"Hospitais e clínicas que um documento pode indicar."_s,
                                        u"Label25"_s, u"Label26"_s, u"Image1"_s),
                     this)
        ->addLayout(listWithButtons(DataGrid1, {Command2, Command3, Command4, Command1}));
    resize(125 * fontMetrics().averageCharWidth(), 30 * fontMetrics().height());
    DataGrid1->setFocus();
}

void frmHospitais::setRows(const ado::RecordsetPtr& hospitals) {
    Adodc1->setRecordset(hospitals);
    DataGrid1->setRecordset(hospitals);
}

void frmHospitais::Command2_Click() {
    const ado::RecordsetPtr rows = data::openToWrite(hospitalQuery(0));
    auto& screen = forms::DefaultInstance<frmHospitais_record>::get();
    screen.Adodc1->setRecordset(rows);
    rows->AddNew();
    screen.ShowModal();
}

void frmHospitais::Command3_Click() {
    const ado::RecordsetPtr rows = data::openToWrite(hospitalQuery(keyOf(*Adodc1, Key)));
    auto& screen = forms::DefaultInstance<frmHospitais_record>::get();
    screen.Adodc1->setRecordset(rows);
    screen.ShowModal();
}

/// Intentional: members who have left and closed years keep no hospital.
void frmHospitais::Command4_Click() {
    const QString id = QString::number(keyOf(*Adodc1, Key));
    if (deleteAsked({.related = {u"Select * from tbZelmar_Movimentos where hospital_id = "_s + id},
                     .row = u"Select * from tbHospitais where hospital_id = "_s + id,
                     .missing =
                         u"Não é possível apagar este registo porque não foi possível encontrar o "
                         "registo na base de dados."_s}))
        Adodc1->Recordset()->Requery();
}

}  // namespace masterdata
