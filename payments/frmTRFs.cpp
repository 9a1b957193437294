// SPDX-License-Identifier: MIT
#include "payments/frmTRFs.h"

#include <QGridLayout>

#include "boundary/environment/dtZelmars.h"
#include "data/Codes.h"
#include "payments/PaymentQueries.h"
#include "payments/frmBanca.h"
#include "platform/core/Clock.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "reports/PaymentReports.h"
#include "reports/ReportRows.h"

using namespace Qt::StringLiterals;

namespace payments {

frmTRFs::frmTRFs()
    : Form(u"frmTRFs"_s, u"Listagem de Pagamentos"_s),
      Text1(new forms::DatePicker(u"Text1"_s)),
      Text2(new forms::DatePicker(u"Text2"_s)),
      DataCombo1(new forms::DataCombo(u"DataCombo1"_s)),
      Check1(new forms::CheckBox(u"Check1"_s, u"Imprimir Automáticamente"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&OK"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Cancelar"_s)),
      Command31(new forms::Button(u"Command31"_s, u"&Banca Eletrónica"_s)) {
    for (forms::DatePicker* date : {Text1, Text2}) {
        date->setValue(core::fromDate(core::today()));
        date->onGotFocus = [date] { date->SelectAll(); };
    }
    DataCombo1->setList(environment::dtZelmars::instance().Recordsets(u"msModosPagamento"_s),
                        u"completo"_s, u"code"_s);
    DataCombo1->setBoundText(data::modo::Transfer.toString());
    Check1->setValue(true);
    layOut();
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Unload(); };
    Command31->onClick = [this] { Command31_Click(); };
    setCancelButton(Command2);
    onBoxClosed = [this](const QString& text) -> QWidget* {
        if (!text.contains("campos da data"_L1)) return nullptr;
        return core::isNull(Text1->Value()) ? Text1 : Text2;
    };
}

void frmTRFs::layOut() {
    auto* days = new forms::Frame(u"Frame1"_s, u"Data da Listagem:"_s);
    auto* row = new QHBoxLayout(days);
    row->addWidget(forms::fieldLabel(u"&De"_s, Text1, u"Label1"_s));
    row->addWidget(Text1);
    row->addWidget(forms::fieldLabel(u"&a"_s, Text2, u"Label2"_s));
    row->addWidget(Text2);
    row->addStretch(1);
    for (forms::DatePicker* date : {Text1, Text2})
        date->setFixedWidth(date->fontMetrics().horizontalAdvance(u"00-00-0000000000"_s));

    auto* kind = new QHBoxLayout;
    kind->addWidget(forms::fieldLabel(u"&Tipo de Lançamento:"_s, DataCombo1, u"Label3"_s));
    kind->addWidget(DataCombo1, 1);

    auto* foot = new QHBoxLayout;
    foot->addWidget(Check1);
    foot->addStretch(1);
    for (forms::Button* button : {Command1, Command31, Command2}) foot->addWidget(button);

    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Listagem de Pagamentos Totais"_s,
                           u"O que se paga por cheque ou por transferência entre dois dias."_s,
                           u"Label4"_s, u"Label5"_s, u"Image1"_s),
        this);
    body->addWidget(days);
    body->addLayout(kind);
    body->addLayout(foot);
    body->addStretch(1);
    Command1->setDefault(true);
    forms::tabThrough({Text1, Text2, DataCombo1, Check1, Command1, Command31, Command2});
    Text1->setFocus();
}

QDate frmTRFs::first() const {
    return core::toDate(Text1->Value());
}

QDate frmTRFs::last() const {
    return core::toDate(Text2->Value());
}

void frmTRFs::Command1_Click() {
    if (core::isNull(Text1->Value()) || core::isNull(Text2->Value())) {
        // Intentional: the title is that of the extracts.
        core::MsgBox(u"Tem de preencher os campos da data!"_s, core::Icon::Information,
                     u"Impressão de Extratos"_s);
        return;
    }
    // Intentional: of any other mode nothing is listed, and no box says so.
    const QString mode = core::toText(DataCombo1->BoundText());
    const auto list = [this](const printing::Report& report, const QString& query) {
        reports::printOrShow(printing::DataReport(report), query, Check1->Value());
    };
    if (mode == data::modo::Cheque)
        list(reports::Print_frmTRF_CHQ(), chequeListQuery(first(), last()));
    else if (mode == data::modo::Transfer)
        list(reports::Print_frmTRF_TRF(), transferListQuery(first(), last()));
    Unload();
}

/// Intentional: always the transfers, whatever is chosen, and the days are not looked at.
void frmTRFs::Command31_Click() {
    auto& screen = forms::DefaultInstance<frmBanca>::get();
    screen.setQuery(typedTransfersQuery(first(), last()));
    Unload();
    screen.ShowModal();
}

}  // namespace payments
