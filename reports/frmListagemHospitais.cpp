// SPDX-License-Identifier: MIT
#include "reports/frmListagemHospitais.h"

#include <QHBoxLayout>

#include "platform/core/Clock.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "reports/HospitalQuery.h"
#include "reports/HospitalReport.h"
#include "reports/ReportRows.h"

using namespace Qt::StringLiterals;

namespace reports {

frmListagemHospitais::frmListagemHospitais()
    : Form(u"frmListagemHospitais"_s, u"Listagem de Hospitais"_s),
      Text1(new forms::DatePicker(u"Text1"_s)),
      Text2(new forms::DatePicker(u"Text2"_s)),
      Check1(new forms::CheckBox(u"Check1"_s, u"Imprimir Automáticamente"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&OK"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Cancelar"_s)) {
    for (forms::DatePicker* date : {Text1, Text2}) {
        date->setValue(core::fromDate(core::today()));
        date->onGotFocus = [date] { date->SelectAll(); };
    }
    layOut();
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Unload(); };
    setCancelButton(Command2);
    onBoxClosed = [this](const QString& text) -> QWidget* {
        if (!text.contains("campos da data"_L1)) return nullptr;
        return core::isNull(Text1->Value()) ? Text1 : Text2;
    };
}

void frmListagemHospitais::layOut() {
    auto* days = new forms::Frame(u"Frame1"_s, u"Data da Listagem:"_s);
    auto* row = new QHBoxLayout(days);
    row->addWidget(forms::fieldLabel(u"&De"_s, Text1, u"Label2"_s));
    row->addWidget(Text1);
    row->addWidget(forms::fieldLabel(u"&a"_s, Text2, u"Label1"_s));
    row->addWidget(Text2);
    row->addStretch(1);
    for (forms::DatePicker* date : {Text1, Text2})
        date->setFixedWidth(date->fontMetrics().horizontalAdvance(u"00-00-0000000000"_s));

    auto* foot = new QHBoxLayout;
    foot->addWidget(Check1);
    foot->addStretch(1);
    for (forms::Button* button : {Command1, Command2}) foot->addWidget(button);

    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Listagem de Hospitais"_s,
                           u"Os movimentos de cada hospital com contas entre dois dias."_s,
                           u"Label3"_s, u"Label4"_s, u"Image1"_s),
        this);
    body->addWidget(days);
    body->addLayout(foot);
    body->addStretch(1);
    Command1->setDefault(true);
    forms::tabThrough({Text1, Text2, Check1, Command1, Command2});
    Text1->setFocus();
}

void frmListagemHospitais::Command1_Click() {
    if (core::isNull(Text1->Value()) || core::isNull(Text2->Value())) {
        // Intentional: the title is that of the extracts.
        core::MsgBox(u"Tem de preencher os campos da data!"_s, core::Icon::Information,
                     u"Impressão de Extratos"_s);
        return;
    }
    printOrShow(printing::DataReport(Print_frmListagemHospitais()),
                hospitalListQuery(core::toDate(Text1->Value()), core::toDate(Text2->Value())),
                Check1->Value());
    Unload();
}

}  // namespace reports
