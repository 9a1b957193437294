// SPDX-License-Identifier: MIT
#include "entry/frmMovimentos.h"

#include <QLabel>

#include "boundary/environment/dtZelmars.h"
#include "coverage/annulment.h"
#include "data/Codes.h"
#include "entry/DocumentVat.h"
#include "payments/frmPagamentoCheque.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace entry {

using core::Icon;
using core::MsgBox;
using forms::BackColor;

frmMovimentos::frmMovimentos()
    : RecordScreen(u"frmMovimentos"_s, u"Lançamento (Plano de Saúde)"_s) {
    makeControls();
    layOut();
    bindControls();
    connectHandlers();
}

void frmMovimentos::bindControls() {
    const environment::dtZelmars& lists = environment::dtZelmars::instance();
    DataCombo1->setList(lists.Recordsets(u"msRubricas"_s), u"completo"_s, u"rubrica_id"_s);
    DataCombo2->setList(lists.Recordsets(u"msHospitais"_s), u"completo"_s, u"hospital_id"_s);
    DataCombo3->setList(lists.Recordsets(u"msModosPagamento"_s), u"completo"_s, u"code"_s);
    DataCombo4->setList(lists.Recordsets(u"msOutrasInstituicoes"_s), u"descrit"_s, u"oe_id"_s);

    const std::pair<forms::Bound*, QString> bindings[] = {
        {Text3, u"codABC"_s},
        {Text1, u"doc_data"_s},
        {Text5, u"doc_no"_s},
        {Text6, u"doc_valor"_s},
        {Text9, u"recebido"_s},
        {Text11, u"doc_tx_iva"_s},
        {Text10, u"doc_iva"_s},
        {DataCombo4, u"oe_id"_s},
        {Text12, u"obs"_s},
        {Text7, u"data"_s},
        {Text8, u"tipo"_s},
        {DataCombo1, u"rubrica_id"_s},
        {DataCombo2, u"hospital_id"_s},
        {DataCombo3, u"modo_pagamento"_s},
    };
    for (const auto& [control, column] : bindings) control->bind(Adodc1, column);
}

void frmMovimentos::connectHandlers() {
    No_Kor->onValidate = [this](bool& cancel) { No_Kor_Validate(cancel); };
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Command2_Click(); };
    connectFieldHandlers();
    Command5->onClick = [this] { Command5_Click(); };
    Command4->onClick = [this] { Command4_Click(); };
    Command6->onClick = [this] { Command6_Click(); };
}

void frmMovimentos::connectFieldHandlers() {
    Text1->onValidate = [this](bool& cancel) { Text1_Validate(cancel); };
    Text5->onGotFocus = [this] { Text5_GotFocus(); };
    Text6->onGotFocus = [this] { Text6->SelectAll(); };
    Text6->onValidate = [this](bool&) { Text6_Validate(); };
    Text9->onGotFocus = [this] { Text9->SelectAll(); };
    Text9->onValidate = [this](bool&) { emptyBecomesNull(Text9); };
    Text11->onValidate = [this](bool& cancel) { Text11_Validate(cancel); };
    // A rubric or hospital that was wiped is held as 0, not as null.
    for (forms::DataCombo* combo : {DataCombo1, DataCombo2}) combo->setWipedValue(0);
}

void frmMovimentos::showAsHospital() {
    if (!Caption().endsWith(u" - Hospital")) setCaption(Caption() + u" - Hospital"_s);
    Label18->show();
    DataCombo2->show();
    Label19->setText(u"Incidência:"_s);
    Text9->bind(Adodc1, u"incidencia"_s);
    DataCombo3->setBoundText(data::modo::Cheque.toString());
}

void frmMovimentos::setMember(qint32 id, const QString& number, const QString& name) {
    Socio_ID = id;
    memberNumber_ = number;
    No_Kor->setText(number);
    Text2->setText(name);
    forms::setBackColor({Text2, Text3, Text4}, BackColor::Window);
    Command2->setEnabled(true);
    Command2->setFocus();
}

void frmMovimentos::showReadOnly(const QString& tipo) {
    if (tipo == data::tipo::Hospital) {
        setCaption(Caption() + u" - Hospital"_s);
        Label18->show();
        DataCombo2->show();
    }
    Command5->hide();
    LimiteAplicavel->hide();
    Label12->hide();

    const std::pair<forms::Bound*, QString> bindings[] = {
        {Incidencia, u"incidencia"_s},
        {Comparticipacao, u"comparticipacao"_s},
        {SaldoCC, u"saldo_acumulado"_s},
        {Iliquido, u"iliquido"_s},
        {SaldoPlafond, u"saldo_plafond"_s},
        {Credito, u"credito"_s},
        {Debito, u"debito"_s},
        {Liquido, u"liquido"_s},
        {No_Kor, u"no_kor"_s},
        {Text2, u"nome"_s},
        {Text4, u"familiar"_s},
    };
    for (const auto& [control, column] : bindings) control->bind(Adodc1, column);

    forms::setBackColor({Text2, Text3, Text4}, BackColor::Window);
    for (forms::TextBox* box : {No_Kor, Text2, Text3, Text4, Text1, Text5, Text6})
        box->setLocked(true);
    for (forms::DataCombo* combo : {DataCombo1, DataCombo2, DataCombo3}) combo->setLocked(true);
    Command1->hide();
    Command2->hide();
    Command6->show();
    showForReading();
}

void frmMovimentos::setDefaults() {
    Text7->setValue(core::fromDate(core::today()));
    Text8->setText((bHospital ? data::tipo::Hospital : data::tipo::Document).toString());
    DataCombo3->setBoundText((bHospital ? data::modo::Cheque : data::modo::Transfer).toString());
}

// --- The document's fields

void frmMovimentos::Text1_Validate(bool& cancel) {
    // Refused without a word: the focus just stays.
    if (!Text1->Text().isEmpty() && !core::parseDate(Text1->Text())) cancel = true;
}

void frmMovimentos::Text5_GotFocus() {
    Text5->limitToColumn();
    Text5->SelectAll();
}

/// A bound box by itself could not do it: an empty text is not a number.
void frmMovimentos::emptyBecomesNull(forms::TextBox* box) {
    if (box->Text().isEmpty() && Adodc1->hasField(box->DataField()))
        Adodc1->Recordset()->setCollect(box->DataField(), QVariant());
}

void frmMovimentos::Text6_Validate() {
    if (bShowing) return;
    if (Text6->Text().isEmpty()) {
        emptyBecomesNull(Text6);
        return;
    }
    // A value that is no number is refused by the binding, right after this.
    if (!core::parseNumber(Text6->Text()) || Text11->Text().isEmpty()) return;
    const std::optional<double> rate = core::parseNumber(Text11->Text());
    if (rate && *rate > 0) workOutVat();
}

void frmMovimentos::Text11_Validate(bool& cancel) {
    // In a view nothing is worked out, and an empty rate must not hold anybody.
    if (bShowing) return;
    const std::optional<double> rate = core::parseNumber(Text11->Text());
    if (!rate) {
        MsgBox(u"O valor que digitou não é um número válido."_s, Icon::Information);
        cancel = true;
    } else if (*rate < 0 || *rate > 100) {
        MsgBox(u"O valor de IVA tem de ser entre 0 e 100."_s, Icon::Information);
        cancel = true;
    } else if (*rate > 0) {
        core::passingOver([this] { workOutVat(); });
    } else {
        core::passingOver([this] { Text10->setText(u"0"_s); });
    }
}

/// From the texts in the boxes; does nothing with a value that is no number.
void frmMovimentos::workOutVat() {
    const std::optional<double> value = core::parseNumber(Text6->Text());
    const std::optional<double> rate = core::parseNumber(Text11->Text());
    if (!value || !rate) return;
    Text10->setValue(vatOf(core::toSingle(*value), *rate));
}

// --- Try-out, posting, giving up, annulment

coverage::Entry frmMovimentos::entry() const {
    coverage::Entry entry;
    entry.record = Adodc1->Recordset();
    entry.Socio_ID = Socio_ID;
    entry.bHospital = bHospital;
    entry.caption = Caption();
    entry.Text3 = Text3->Text();
    entry.Text6 = Text6->Text();
    entry.Text9 = Text9->Text();
    entry.DataCombo1 = DataCombo1->Text();
    entry.rubrica_id = DataCombo1->BoundText();
    return entry;
}

void frmMovimentos::Command5_Click() {
    coverage::TryOut run;
    run.onShown = [this](const coverage::Results& results) { showResults(results); };
    coverage::tryOut(entry(), run);
}

void frmMovimentos::post() {
    const coverage::PostingEntry posting{entry(),
                                         DataCombo3->Text(),
                                         DataCombo3->BoundText(),
                                         Text7->Text(),
                                         Text1->Text(),
                                         Text5->Text(),
                                         DataCombo2->Text(),
                                         &payments::frmPagamentoCheque::ask};
    coverage::TryOut run;
    run.onShown = [this](const coverage::Results& results) { showResults(results); };
    if (coverage::post(posting, run, operation_)) return leaveEntry();
    if (operation_.isRegistered) lockFields();
}

void frmMovimentos::Command4_Click() {
    leaveEntry();
}

void frmMovimentos::leaveEntry() {
    operation_ = {};
    Hide();
    if (onLeft) onLeft();
}

void frmMovimentos::Command6_Click() {
    if (coverage::annul({Adodc1->Recordset(), Caption(), CallbackClass}, operation_)) Unload();
}

void frmMovimentos::showResults(const coverage::Results& results) {
    const auto put = [](forms::TextBox* box, const std::optional<QVariant>& value) {
        if (value) box->setValue(*value);
    };
    put(LimiteAplicavel, results.LimiteAplicavel);
    put(Incidencia, results.Incidencia);
    put(Comparticipacao, results.Comparticipacao);
    put(SaldoPlafond, results.SaldoPlafond);
    put(SaldoCC, results.SaldoCC);
    put(Iliquido, results.Iliquido);
    put(Liquido, results.Liquido);
    put(Credito, results.Credito);
    put(Debito, results.Debito);
}

}  // namespace entry
