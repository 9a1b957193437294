// SPDX-License-Identifier: MIT
#include "companions/tiqueta/frmFichaSocio.h"

#include <QBoxLayout>
#include <QGridLayout>
#include <QLabel>

#include "companions/tiqueta/Nib.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Fields.h"
#include "platform/forms/TextBox.h"

using namespace Qt::StringLiterals;

namespace tiqueta {
namespace {

QString memberQuery(int socioId) {
    return u"SELECT * FROM tbSocios WHERE socio_id = %1"_s.arg(socioId);
}

// Label and field side by side; the width is in characters.
void addField(QGridLayout* grid, int row, int column, const QString& label, forms::TextBox* field,
              int width, int span = 1) {
    field->setMinimumWidth(width * field->fontMetrics().averageCharWidth());
    auto* text = forms::fieldLabel(label, field, u"lbl"_s + field->objectName().mid(3));
    if (column == 0) text->setMinimumWidth(19 * field->fontMetrics().averageCharWidth());
    grid->addWidget(text, row, column);
    grid->addWidget(field, row, column + 1, 1, span);
}

}  // namespace

void frmFichaSocio::edit(const ado::ConnectionPtr& connection, int socioId) {
    const auto member = ado::Recordset::create();
    member->Open(memberQuery(socioId), connection, ado::adOpenStatic, ado::adLockOptimistic);
    if (member->atEnd())
        throw core::Failure(
            core::NoCurrentRow,
            u"O associado com o registo %1 não se encontra na tabela de activos."_s.arg(socioId));
    (new frmFichaSocio(member))->ShowModal();
}

frmFichaSocio::frmFichaSocio(const ado::RecordsetPtr& member)
    : Form(u"frmFichaSocio"_s, u"Ficha de Associado"_s),
      member_(member),
      Adodc1(new forms::DataControl(u"Adodc1"_s, this)),
      txtNumero(new forms::TextBox(u"txtNumero"_s, this)),
      txtNome(new forms::TextBox(u"txtNome"_s, this)),
      txtNomeGuerra(new forms::TextBox(u"txtNomeGuerra"_s, this)),
      txtContribuinte(new forms::TextBox(u"txtContribuinte"_s, this)),
      txtNib(new forms::TextBox(u"txtNib"_s, this)),
      lblNib(new QLabel(this)),
      txtCarencia(new forms::TextBox(u"txtCarencia"_s, this)),
      chkZelmar(new forms::CheckBox(u"chkZelmar"_s, u"Inscrito no plano de &Saúde"_s, this)),
      txtMorada(new forms::TextBox(u"txtMorada"_s, this)),
      txtCodigoPostal(new forms::TextBox(u"txtCodigoPostal"_s, this)),
      txtLocalidade(new forms::TextBox(u"txtLocalidade"_s, this)),
      cmdOK(new forms::Button(u"cmdOK"_s, u"&OK"_s, this)),
      cmdCancelar(new forms::Button(u"cmdCancelar"_s, u"&Cancelar"_s, this)) {
    layOut();
    bindFields();
    connectHandlers();
    showHint();
}

void frmFichaSocio::layOut() {
    lblNib->setObjectName(u"lblControloNib"_s);
    txtNumero->setDisplayOnly();
    txtCarencia->setFormat(core::format::Date);
    cmdOK->setDefault(true);
    setCancelButton(cmdCancelar);
    forms::passesValidation(cmdCancelar);

    auto* buttons = new QHBoxLayout;
    buttons->addStretch(1);
    buttons->addWidget(cmdOK);
    buttons->addWidget(cmdCancelar);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Ficha de Associado"_s,
                           u"Dados do associado, da conta bancária e da inscrição."_s,
                           u"lblTitulo"_s, u"lblExplicacao"_s, u"picTitulo"_s),
        this);
    for (auto* frame : {identification(), plan(), address()}) body->addWidget(frame);
    body->addLayout(buttons);
}

QWidget* frmFichaSocio::identification() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Identificação:"_s, this);
    auto* grid = new QGridLayout(frame);
    addField(grid, 0, 0, u"Número KOR:"_s, txtNumero, 14);
    addField(grid, 1, 0, u"&Nome:"_s, txtNome, 60, 3);
    addField(grid, 2, 0, u"Nome a&breviado:"_s, txtNomeGuerra, 30);
    addField(grid, 2, 2, u"N.º cont&ribuinte:"_s, txtContribuinte, 16);
    return frame;
}

QWidget* frmFichaSocio::plan() {
    auto* frame = new forms::Frame(u"Frame2"_s, u"Plano de Saúde e pagamentos:"_s, this);
    auto* grid = new QGridLayout(frame);
    addField(grid, 0, 0, u"N&IB:"_s, txtNib, 30);
    grid->addWidget(lblNib, 0, 2, 1, 2);
    addField(grid, 1, 0, u"Carência a&té:"_s, txtCarencia, 14);
    grid->addWidget(chkZelmar, 1, 2, 1, 2);
    grid->setColumnStretch(3, 1);
    return frame;
}

QWidget* frmFichaSocio::address() {
    auto* frame = new forms::Frame(u"Frame3"_s, u"Morada:"_s, this);
    auto* grid = new QGridLayout(frame);
    addField(grid, 0, 0, u"&Morada:"_s, txtMorada, 60, 3);
    addField(grid, 1, 0, u"Código &postal:"_s, txtCodigoPostal, 14);
    addField(grid, 1, 2, u"&Localidade:"_s, txtLocalidade, 30);
    return frame;
}

void frmFichaSocio::bindFields() {
    Adodc1->setRecordset(member_);
    forms::bindAll(Adodc1, {{txtNumero, u"no_kor"_s},
                            {txtContribuinte, u"no_contribuinte"_s},
                            {txtNome, u"nome"_s},
                            {txtNomeGuerra, u"nome_guerra"_s},
                            {txtNib, u"nib"_s},
                            {txtCarencia, u"zelmar_data_carencia"_s},
                            {txtMorada, u"morada1"_s},
                            {txtCodigoPostal, u"code_postal1"_s},
                            {txtLocalidade, u"localidade1"_s}});
    chkZelmar->setChecked(isEnrolled());
}

void frmFichaSocio::connectHandlers() {
    connect(txtNib, &QLineEdit::textChanged, this, &frmFichaSocio::showHint);
    txtNib->onValidate = [this](bool&) {
        if (const QString nib = compactNib(txtNib->Text()); nib != txtNib->Text())
            txtNib->setText(nib);
    };
    cmdOK->onClick = [this] { store(); };
    cmdCancelar->onClick = [this] { Unload(); };
}

bool frmFichaSocio::isEnrolled() const {
    const QVariant zelmar = member_->Collect(u"zelmar"_s);
    return !core::isNull(zelmar) && core::toDouble(zelmar) != 0;
}

void frmFichaSocio::showHint() {
    lblNib->setText(nibHint(txtNib->Text()));
}

void frmFichaSocio::store() {
    if (chkZelmar->isChecked() != isEnrolled())
        member_->setCollect(u"zelmar"_s, chkZelmar->isChecked() ? 1 : 0);
    member_->Update();
    Unload();
}

}  // namespace tiqueta
