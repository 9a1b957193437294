// SPDX-License-Identifier: MIT
#include "reports/frmExtratos.h"

#include <QGridLayout>
#include <QLabel>
#include <QScopeGuard>

#include "data/Members.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "reports/ExtractQuery.h"
#include "reports/ExtractReports.h"
#include "reports/ReportRows.h"

using namespace Qt::StringLiterals;

namespace reports {

using namespace printing;

using core::Icon;
using core::MsgBox;
using forms::BackColor;

frmExtratos::frmExtratos() : Form(u"frmExtratos"_s, u"Impressão de Extratos"_s) {
    makeControls();
    layOut();
    connectHandlers();
    showOption();
}

void frmExtratos::makeControls() {
    No_Kor = new forms::TextBox(u"No_Kor"_s);
    No_Kor->setFormat(core::format::Number);
    Text2 = new forms::TextBox(u"Text2"_s);
    Text2->setDisplayOnly();
    Text2->setBackColor(BackColor::Menu);
    Command1 = new forms::Button(u"Command1"_s, u"Procurar Sócio"_s);
    Command1->setKey(u"Alt+P"_s);

    Option1 = new forms::OptionButton(u"Option1"_s, u"Selecionado por data:"_s);
    Option1->setChecked(true);
    Option2 = new forms::OptionButton(u"Option2"_s, u"Selecionado por documento:"_s);
    Text3 = new forms::DatePicker(u"Text3"_s);
    Text4 = new forms::DatePicker(u"Text4"_s);
    for (forms::DatePicker* date : {Text3, Text4}) date->setValue(core::fromDate(core::today()));
    Label2 = new QLabel(u"a"_s);
    Label2->setObjectName(u"Label2"_s);
    Text1 = new forms::TextBox(u"Text1"_s);
    Text3->setAccessibleName(u"Primeiro dia"_s);
    Text4->setAccessibleName(u"Último dia"_s);
    Text1->setAccessibleName(u"Documento"_s);

    Check1 = new forms::CheckBox(u"Check1"_s, u"Imprimir Automáticamente"_s);
    Check2 = new forms::CheckBox(u"Check2"_s, u"Imprimir Extrato Detalhado"_s);
    for (forms::CheckBox* check : {Check1, Check2}) check->setValue(true);
    Imprimir = new forms::Button(u"Imprimir"_s, u"&Imprimir"_s);
    Command4 = new forms::Button(u"Command4"_s, u"&Fechar"_s);
}

QWidget* frmExtratos::beneficiaryFrame() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Identificação do Beneficiário:"_s);
    auto* row = new QHBoxLayout(frame);
    row->addWidget(forms::fieldLabel(u"Número &KOR:"_s, No_Kor, u"Label1"_s));
    row->addWidget(No_Kor);
    row->addWidget(Text2, 1);
    row->addWidget(Command1);
    No_Kor->setFixedWidth(No_Kor->fontMetrics().horizontalAdvance(u"000000000000"_s));
    Text2->setAccessibleName(u"Nome do sócio"_s);
    Text2->setMinimumWidth(Text2->fontMetrics().averageCharWidth() * 50);
    return frame;
}

QWidget* frmExtratos::kindFrame() {
    auto* frame = new forms::Frame(u"Frame2"_s, u"Tipo de Impressão"_s);
    auto* grid = new QGridLayout(frame);
    grid->addWidget(Option1, 0, 0);
    grid->addWidget(Text3, 0, 1);
    grid->addWidget(Label2, 0, 2);
    grid->addWidget(Text4, 0, 3);
    grid->addWidget(Option2, 1, 0);
    grid->addWidget(Text1, 1, 1, 1, 3);
    grid->setColumnStretch(4, 1);
    // Fields that are hidden keep their room, so that nothing moves.
    for (int line : {0, 1}) grid->setRowMinimumHeight(line, Text1->sizeHint().height());
    for (forms::DatePicker* date : {Text3, Text4})
        date->setFixedWidth(date->fontMetrics().horizontalAdvance(u"00-00-0000000000"_s));
    grid->setColumnMinimumWidth(1, Text3->width());
    grid->setColumnMinimumWidth(3, Text4->width());
    return frame;
}

void frmExtratos::layOut() {
    auto* foot = new QGridLayout;
    foot->addWidget(Check1, 0, 0);
    foot->addWidget(Check2, 1, 0);
    foot->setColumnStretch(1, 1);
    foot->addWidget(Imprimir, 1, 2);
    foot->addWidget(Command4, 1, 3);

    QVBoxLayout* body =
        forms::bodyUnder(forms::headingBand(u"Impressão de Extratos de Movimentos"_s, {},
                                            u"Label3"_s, u"Label4"_s, u"Image1"_s),
                         this);
    body->addWidget(beneficiaryFrame());
    body->addWidget(kindFrame());
    body->addLayout(foot);
    body->addStretch(1);

    Imprimir->setDefault(true);
    QWidget* const order[] = {No_Kor, Command1, Option1, Text3,    Text4,   Option2,
                              Text1,  Check1,   Check2,  Imprimir, Command4};
    for (std::size_t at = 1; at < std::size(order); ++at) setTabOrder(order[at - 1], order[at]);
    No_Kor->setFocus();
}

void frmExtratos::connectHandlers() {
    for (forms::TextBox* box : {No_Kor, Text1}) box->onGotFocus = [box] { box->SelectAll(); };
    No_Kor->onValidate = [this](bool& cancel) { No_Kor_Validate(cancel); };
    Command1->onClick = [this] { Command1_Click(); };
    connect(Option1, &QRadioButton::toggled, this, &frmExtratos::showOption);
    onBoxClosed = [this](const QString& text) { return fieldNamedBy(text); };
    Imprimir->onClick = [this] { Imprimir_Click(); };
    Command4->onClick = [this] { Command4_Click(); };
    setCancelButton(Command4);
}

// --- The member

void frmExtratos::setMember(qint32 id, const QString& number, const QString& name) {
    socio_id_ = id;
    No_Kor->setText(number);
    Text2->setText(name);
    Text2->setBackColor(id != 0 ? BackColor::Window : BackColor::Menu);
    if (id != 0) Text3->setFocus();
}

void frmExtratos::clearMember() {
    Text2->setBackColor(BackColor::Menu);
    Text2->Clear();
    socio_id_ = 0;
}

void frmExtratos::No_Kor_Validate(bool& cancel) {
    if (No_Kor->Text().isEmpty()) {
        clearMember();
        return;
    }
    const ado::RecordsetPtr member = data::openMemberByNumber(No_Kor->Text());
    if (!member) {
        clearMember();
        MsgBox(u"Número de Empresa não encontrado!"_s, Icon::Critical, u"Sócios"_s);
        cancel = true;
        return;
    }
    socio_id_ = core::toLong(member->Collect(u"socio_id"_s));
    Text2->setBackColor(BackColor::Window);
    Text2->setText(core::toText(member->Collect(u"nome"_s)));
    member->Close();
}

/// Intentional: a search that fails says nothing, and members outside the plan may be chosen too.
void frmExtratos::Command1_Click() {
    core::passingOver([this] {
        const qint32 id = data::chooseMember(data::openSearch());
        if (id == 0) return;
        socio_id_ = id;
        No_Kor->setText(core::toText(data::ofMember(id, u"no_kor"_s)));
        Text2->setText(core::toText(data::ofMember(id, u"nome"_s)));
        Text2->setBackColor(BackColor::Window);
    });
}

// --- What is printed

void frmExtratos::showOption() {
    for (QWidget* control : std::initializer_list<QWidget*>{Label2, Text3, Text4})
        control->setVisible(Option1->isChecked());
    Text1->setVisible(Option2->isChecked());
}

QString frmExtratos::missing() const {
    if (socio_id_ == 0) return u"Tem de indicar um associado!"_s;
    if (Option1->isChecked() && (core::isNull(Text3->Value()) || core::isNull(Text4->Value())))
        return u"Tem de preencher os campos da data!"_s;
    if (Option2->isChecked() && Text1->Text().isEmpty())
        return u"Tem de preencher o campo do documento!"_s;
    return {};
}

QWidget* frmExtratos::fieldNamedBy(const QString& text) const {
    if (text.contains("um associado"_L1)) return No_Kor;
    if (text.contains("campos da data"_L1)) return core::isNull(Text3->Value()) ? Text3 : Text4;
    return text.contains("campo do documento"_L1) ? Text1 : nullptr;
}

Selection frmExtratos::selection() const {
    return {.socio_id = socio_id_,
            .detailed = Check2->Value(),
            .byDocument = Option2->isChecked(),
            .first = core::toDate(Text3->Value()),
            .last = core::toDate(Text4->Value()),
            .doc_no = Text1->Text()};
}

void frmExtratos::Imprimir_Click() {
    if (const QString text = missing(); !text.isEmpty()) {
        MsgBox(text, Icon::Information, u"Impressão de Extratos"_s);
        return;
    }
    Command4->setFocus();
    Imprimir->setEnabled(false);
    // A failure leaves the dialog ready for the next try, and Enter must not close it.
    auto again = qScopeGuard([this] {
        Imprimir->setEnabled(true);
        Imprimir->setFocus();
    });
    // Intentional: a member who has left the table of active members gets no extract, and no box
    // says so.
    const ado::RecordsetPtr member = data::openMemberById(socio_id_);
    if (!member->atEnd()) print(*member);
    member->Close();
    again.dismiss();
    Imprimir->setEnabled(true);
    Unload();
}

void frmExtratos::print(const ado::Recordset& member) {
    printOrShow(extractOf(member, Check2->Value()), extractQuery(selection()), Check1->Value());
}

void frmExtratos::Command4_Click() {
    Unload();
    if (Show_Options && onClosed) onClosed();
}

}  // namespace reports
