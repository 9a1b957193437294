// SPDX-License-Identifier: MIT
#include "host/frmServidor.h"

#include <QBoxLayout>
#include <QGridLayout>

#include "platform/ado/postgres/Address.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

const QString Server = u"postgresql:"_s;

}  // namespace

frmServidor::frmServidor(const registry::LoginValues& proposed)
    : Form(u"frmServidor"_s, u"Livro num servidor"_s),
      Text1(forms::textBox(u"Text1"_s)),
      Text2(forms::textBox(u"Text2"_s)),
      Text3(forms::textBox(u"Text3"_s)),
      Text4(forms::textBox(u"Text4"_s)),
      Text5(forms::textBox(u"Text5"_s)),
      Check1(new forms::CheckBox(u"Check1"_s, u"Ligação &sem cifra (só numa rede de confiança)"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&Ligar"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Cancelar"_s)) {
    Text5->setEchoMode(QLineEdit::Password);
    Text2->setPlaceholderText(u"5432"_s);
    layOut();
    if (proposed.dtDataSource.startsWith(Server)) {
        ado::postgres::Address address;
        address.place(proposed.dtDataSource.mid(Server.size()));
        Text1->setText(address.host);
        Text2->setText(address.port);
        Check1->setValue(address.allowsPlain);
    }
    Text3->setText(proposed.dtInitialCatalog);
    Text4->setText(proposed.dtUser);
    QWidget* first = missing();
    (first ? first : Text5)->setFocus();
    setCancelButton(Command2);
    letEnterGoOn(Command1);
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Unload(); };
}

void frmServidor::layOut() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"O livro:"_s);
    QGridLayout* grid = forms::pairsIn(frame, {u"Palavra-passe:"});
    forms::addRow(grid, 0, u"Se&rvidor:"_s, {Text1}, u"Label3"_s);
    forms::addRow(grid, 1, u"&Porta:"_s, {Text2}, u"Label4"_s);
    forms::addRow(grid, 2, u"L&ivro:"_s, {Text3}, u"Label5"_s);
    forms::addRow(grid, 3, u"&Utilizador:"_s, {Text4}, u"Label6"_s);
    forms::addRow(grid, 4, u"P&alavra-passe:"_s, {Text5}, u"Label7"_s);
    grid->addWidget(Check1, 5, 1, 1, -1);
    Text1->setMinimumWidth(forms::widthFor(Text1, u"servidor.do-nosso-escritorio.pt"));
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    foot->addWidget(Command1);
    foot->addWidget(Command2);
    QVBoxLayout* body =
        forms::bodyUnder(forms::headingBand(u"Livro num servidor"_s,
                                            u"Estes dados dá-os quem administra o servidor."_s,
                                            u"Label1"_s, u"Label2"_s, u"Image1"_s),
                         this);
    body->addWidget(frame);
    body->addLayout(foot);
    body->addStretch(1);
    Command1->setDefault(true);
    forms::tabThrough({Text1, Text2, Text3, Text4, Text5, Check1, Command1, Command2});
}

/// The first field that has to be filled in and is not; null when all are.
QWidget* frmServidor::missing() const {
    for (forms::TextBox* box : {Text1, Text3, Text4})
        if (box->Text().trimmed().isEmpty()) return box;
    return nullptr;
}

void frmServidor::Command1_Click() {
    if (QWidget* field = missing()) {
        core::MsgBox(u"Preencha o servidor, o livro e o utilizador."_s, core::Icon::Information,
                     Caption());
        return field->setFocus();
    }
    ado::postgres::Address address;
    address.place(Text1->Text().trimmed() +
                  (Text2->Text().trimmed().isEmpty() ? QString() : u':' + Text2->Text().trimmed()));
    address.allowsPlain = Check1->Value();
    registry::LoginValues book;
    book.dtDataSource = address.dataSource();
    book.dtInitialCatalog = Text3->Text().trimmed();
    book.dtUser = Text4->Text().trimmed();
    book.dtPassword = Text5->Text();
    onAccepted(book);
    Unload();
}

}  // namespace host
