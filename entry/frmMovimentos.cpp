// SPDX-License-Identifier: MIT
#include "entry/frmMovimentos.h"

#include <QLabel>
#include <QShortcut>

#include "boundary/environment/dtZelmars.h"
#include "coverage/annulment.h"
#include "data/Codes.h"
#include "data/MovementNote.h"
#include "entry/DocumentVat.h"
#include "entry/frmExplicacao.h"
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

namespace {

/// The number that a box holds, with the digits that its format does not show; nothing for a text
/// that is none.
std::optional<double> numberIn(const forms::TextBox* box) {
    if (!core::parseNumber(box->Text())) return {};
    return core::toDouble(box->Value());
}

}  // namespace

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

    forms::bindAll(Adodc1, {{Text3, u"codABC"_s},
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
                            {DataCombo3, u"modo_pagamento"_s}});
}

void frmMovimentos::connectHandlers() {
    No_Kor->onValidate = [this](bool& cancel) { No_Kor_Validate(cancel); };
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Command2_Click(); };
    connectFieldHandlers();
    Command5->onClick = [this] { Command5_Click(); };
    Command4->onClick = [this] { Command4_Click(); };
    Command6->onClick = [this] { Command6_Click(); };
    connect(new QShortcut(Qt::Key_F2, this), &QShortcut::activated, this,
            [this] { forms::handle([this] { explain(); }); });
}

void frmMovimentos::connectFieldHandlers() {
    Text1->onValidate = [this](bool& cancel) { Text1_Validate(cancel); };
    Text5->onGotFocus = [this] { Text5_GotFocus(); };
    Text6->onGotFocus = [this] { Text6->SelectAll(); };
    Text6->onValidate = [this](bool& cancel) { Text6_Validate(cancel); };
    Text9->onGotFocus = [this] { Text9->SelectAll(); };
    Text9->onValidate = [this](bool&) { Text9->storeNullIfEmpty(); };
    Text11->onValidate = [this](bool& cancel) { Text11_Validate(cancel); };
    onBoxClosed = [this](const QString& text) { return fieldNamedBy(text); };
    // A rubric or hospital that was wiped is held as 0, not as null.
    for (forms::DataCombo* combo : {DataCombo1, DataCombo2}) combo->setWipedValue(0);
}

void frmMovimentos::showAsHospital() {
    if (!Caption().endsWith(u" - Hospital")) setCaption(Caption() + u" - Hospital"_s);
    Label18->show();
    DataCombo2->show();
    forms::setFieldLabel(Label19, u"Incidênci&a:"_s);
    Text9->bind(Adodc1, u"incidencia"_s);
    DataCombo3->setBoundText(data::modo::Cheque.toString());
}

void frmMovimentos::forgetEntry() {
    No_Kor->Clear();
    clearMember();
    operation_ = {};
    explained_.reset();
    for (const ResultBox& result : resultBoxes()) result.box->Clear();
}

void frmMovimentos::setMember(qint32 id, const QString& number, const QString& name) {
    Socio_ID = id;
    memberNumber_ = number;
    No_Kor->setText(number);
    Text2->setText(name);
    forms::setBackColor({Text2, Text3, Text4}, BackColor::Window);
    Command2->setEnabled(true);
    Command2->setFocus(Qt::TabFocusReason);
}

/// Without a person the typist goes on at the button that chooses one.
bool frmMovimentos::stopsEnter(const QWidget* control) const {
    return control == Command2 ? Text3->Text().isEmpty() : RecordScreen::stopsEnter(control);
}

/// What a refusal of the try-out or the posting speaks of.
QWidget* frmMovimentos::fieldNamedBy(const QString& text) const {
    const std::pair<QStringView, QWidget*> named[] = {
        {u"indicar um modo de pagamento", DataCombo3},
        {u"data do documento", Text1},
        {u"número do documento", Text5},
        {u"indicar um hospital", DataCombo2},
        {u"indicar uma rubrica", DataCombo1},
        {u"código de familiar", Socio_ID != 0 ? static_cast<QWidget*>(Command2) : No_Kor},
        {u"valor de incidência", Text9},
        {u"valor para o campo Recebido", Text9},
        {u"O valor recebido é", Text9},
        {u"valor para o documento", Text6},
        {u"O valor do documento é", Text6},
    };
    for (const auto& [words, field] : named)
        if (text.contains(words, Qt::CaseInsensitive)) return field;
    return nullptr;
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

    forms::bindAll(Adodc1, {{No_Kor, u"no_kor"_s}, {Text2, u"nome"_s}, {Text4, u"familiar"_s}});
    for (const ResultBox& result : resultBoxes())
        if (!result.column.isEmpty()) result.box->bind(Adodc1, result.column);

    forms::setBackColor({Text2, Text3, Text4}, BackColor::Window);
    for (forms::TextBox* box : {No_Kor, Text2, Text3, Text4, Text1, Text5, Text6})
        box->setLocked(true);
    forms::setBackColor({No_Kor, Text1, Text5, Text6}, BackColor::Menu);
    for (forms::DataCombo* combo : {DataCombo1, DataCombo2, DataCombo3}) combo->setLocked(true);
    Command1->hide();
    Command2->hide();
    Command6->show();
    showForReading(data::noteOf(*Adodc1->Recordset()));
}

void frmMovimentos::setDefaults() {
    Text7->setValue(core::fromDate(core::today()));
    Text8->setText((bHospital ? data::tipo::Hospital : data::tipo::Document).toString());
    DataCombo3->setBoundText((bHospital ? data::modo::Cheque : data::modo::Transfer).toString());
    // A member known from the entry before was never typed here.
    if (Socio_ID != 0) rateHoldsAValue();
}

/// Typing a member's number resets the VAT. A member who came by another way resets nothing, but
/// the rate that nobody has typed must not hold the typist: an empty one cannot be left.
void frmMovimentos::rateHoldsAValue() {
    if (!Text11->Text().isEmpty()) return;
    Text10->setText(u"0"_s);
    Text11->setText(u"0"_s);
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

void frmMovimentos::Text6_Validate(bool& cancel) {
    if (bShowing()) return;
    if (Text6->Text().isEmpty()) {
        Text6->storeNullIfEmpty();
        return;
    }
    // A value that is no number is refused by the binding, right after this.
    const std::optional<double> rate = numberIn(Text11);
    if (!numberIn(Text6) || !rate || *rate <= 0) return;
    try {
        workOutVat();
    } catch (const core::Failure& failure) {
        if (failure.number() != core::Overflow) throw;
        MsgBox(u"O valor %1 é demasiado grande para calcular o IVA."_s.arg(Text6->Text()),
               Icon::Information);
        cancel = true;
    }
}

void frmMovimentos::Text11_Validate(bool& cancel) {
    // In a view nothing is worked out, and an empty rate must not hold anybody.
    if (bShowing()) return;
    const std::optional<double> rate = numberIn(Text11);
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

/// From what the boxes hold; does nothing with a value that is no number.
void frmMovimentos::workOutVat() {
    const std::optional<double> value = numberIn(Text6);
    const std::optional<double> rate = numberIn(Text11);
    if (!value || !rate) return;
    Text10->setValue(vatOf(core::Single(*value), *rate));
}

// --- Try-out, posting, giving up, annulment

coverage::Document frmMovimentos::document() const {
    return {.record = Adodc1->Recordset(),
            .socio_id = Socio_ID,
            .isHospital = bHospital,
            .caption = Caption(),
            .personCode = Text3->Text(),
            .documentValue = Text6->Text(),
            .receivedOrIncidence = Text9->Text(),
            .rubric = DataCombo1->Text(),
            .rubrica_id = DataCombo1->BoundText()};
}

std::vector<frmMovimentos::ResultBox> frmMovimentos::resultBoxes() const {
    using coverage::Result;
    return {{Result::LimiteAplicavel, LimiteAplicavel, {}},
            {Result::Incidencia, Incidencia, u"incidencia"_s},
            {Result::Comparticipacao, Comparticipacao, u"comparticipacao"_s},
            {Result::SaldoPlafond, SaldoPlafond, u"saldo_plafond"_s},
            {Result::SaldoCC, SaldoCC, u"saldo_acumulado"_s},
            {Result::Iliquido, Iliquido, u"iliquido"_s},
            {Result::Liquido, Liquido, u"liquido"_s},
            {Result::Credito, Credito, u"credito"_s},
            {Result::Debito, Debito, u"debito"_s}};
}

/// A run whose results stand on the screen as soon as they are reached.
coverage::TryOut frmMovimentos::tryOutShown() {
    coverage::TryOut run;
    run.onShown = [boxes = resultBoxes()](coverage::Result result, const QVariant& value) {
        for (const ResultBox& each : boxes)
            if (each.result == result) each.box->setValue(value);
    };
    return run;
}

QVariantList frmMovimentos::asked() const {
    return {Socio_ID, Text3->Text(), DataCombo1->BoundText(), Text6->Value(), Text9->Value()};
}

/// Work with a try-out in it, of which F2 tells afterwards.
void frmMovimentos::tryOutAs(const std::function<void(coverage::TryOut& run)>& work) {
    explained_.reset();
    const QVariantList of = asked();
    coverage::TryOut run = tryOutShown();
    work(run);
    explained_ = {run.explanation, of};
}

void frmMovimentos::Command5_Click() {
    tryOutAs([this](coverage::TryOut& run) { coverage::tryOut(document(), run); });
}

/// Shows why the try-out came to its amounts.
void frmMovimentos::explain() {
    QString why;
    if (bShowing())
        why = u"Este movimento já está lançado: o porquê vê-se ao lançar, depois do ensaio."_s;
    else if (!explained_)
        why = u"Ainda não há ensaio. Faça o ensaio (F9); F2 diz então porquê."_s;
    else if (explained_->of != asked())
        why = u"O documento mudou depois do ensaio. Faça o ensaio de novo (F9), e depois F2."_s;
    else if (explained_->explanation.end == coverage::Explanation::End::Refused)
        why =
            u"O ensaio foi recusado antes de calcular. Corrija o que ele disse e faça-o de novo "
            "(F9)."_s;
    if (!why.isEmpty()) {
        MsgBox(why, Icon::Information, Caption());
        return;
    }
    auto* shown = new frmExplicacao(explained_->explanation);
    shown->ShowModal();
}

void frmMovimentos::post() {
    const coverage::Posting posting{.document = document(),
                                    .paymentMode = DataCombo3->Text(),
                                    .modo_pagamento = DataCombo3->BoundText(),
                                    .movementDate = Text7->Text(),
                                    .documentDate = Text1->Text(),
                                    .documentNumber = Text5->Text(),
                                    .hospital = DataCombo2->Text(),
                                    .askCheque = &payments::frmPagamentoCheque::ask};
    bool isPosted = false;
    tryOutAs([&](coverage::TryOut& run) { isPosted = coverage::post(posting, run, operation_); });
    if (isPosted) return leaveEntry(u"Lançado com o nº %1"_s.arg(operation_.movimento_no));
    if (operation_.isRegistered) lockFields();
}

void frmMovimentos::Command4_Click() {
    if (!mayGiveUp()) return;
    leaveEntry(operation_.isRegistered ? u"Lançado com o nº %1; "_s.arg(operation_.movimento_no) +
                                             data::missingText(operation_)
                                       : u"Nada foi lançado"_s);
}

void frmMovimentos::leaveEntry(const QString& outcome) {
    Hide();
    if (onLeft) onLeft(outcome);
}

void frmMovimentos::Command6_Click() {
    if (coverage::annul(
            {.shown = Adodc1->Recordset(), .caption = Caption(), .CallbackClass = CallbackClass},
            operation_))
        Unload();
}

}  // namespace entry
