// SPDX-License-Identifier: MIT
#include "host/frmDocumentos.h"

#include <QComboBox>
#include <QFileDialog>
#include <QGridLayout>
#include <QLabel>
#include <QStandardPaths>

#include "host/BookSettings.h"
#include "platform/core/Clock.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "platform/printing/Progress.h"

using namespace Qt::StringLiterals;

namespace host {

using documents::Kind;

namespace {

QString documentsFolder() {
    return QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation);
}

/// "1 documento", "1.234 documentos"
QString counted(qsizetype count) {
    return core::grouped(count) + (count == 1 ? u" documento"_s : u" documentos"_s);
}

}  // namespace

frmDocumentos::frmDocumentos()
    : Form(u"frmDocumentos"_s, u"Documentos de todos os associados"_s),
      book_(documents::openBook(BookSettings::read().connectionString())),
      Option1(new forms::OptionButton(u"Option1"_s, u"&Extratos"_s)),
      Option2(new forms::OptionButton(u"Option2"_s, u"&Cartas de dívidas"_s)),
      Option3(new forms::OptionButton(u"Option3"_s, u"Declarações de &IRS"_s)),
      Text1(new forms::DatePicker(u"Text1"_s)),
      Text2(new forms::DatePicker(u"Text2"_s)),
      Check1(new forms::CheckBox(u"Check1"_s, u"Extrato de&talhado"_s)),
      Combo1(new QComboBox),
      Command1(new forms::Button(u"Command1"_s, u"&Um PDF por associado…"_s)),
      Command2(new forms::Button(u"Command2"_s, u"Um &só PDF…"_s)),
      Command3(new forms::Button(u"Command3"_s, u"&Fechar"_s)) {
    const int year = core::today().year();
    Text1->setValue(core::fromDate(QDate(year, 1, 1)));
    Text2->setValue(core::fromDate(core::today()));
    for (forms::DatePicker* date : {Text1, Text2}) date->onGotFocus = [date] { date->SelectAll(); };
    Combo1->setObjectName(u"Combo1"_s);
    for (const int closed : documents::closedYears(book_))
        Combo1->addItem(QString::number(closed), closed);
    Option1->setChecked(true);
    layOut();
    for (forms::OptionButton* option : {Option1, Option2, Option3})
        connect(option, &QRadioButton::toggled, this, &frmDocumentos::showKind);
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Command2_Click(); };
    Command3->onClick = [this] { Unload(); };
    setCancelButton(Command3);
    showKind();
}

void frmDocumentos::layOut() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Documentos:"_s);
    auto* grid = new QGridLayout(frame);
    Label1 = forms::fieldLabel(u"&De"_s, Text1, u"Label1"_s);
    Label2 = forms::fieldLabel(u"&a"_s, Text2, u"Label2"_s);
    Label3 = forms::fieldLabel(u"A&no"_s, Combo1, u"Label3"_s);
    grid->addWidget(Option1, 0, 0);
    grid->addWidget(Label1, 0, 1);
    grid->addWidget(Text1, 0, 2);
    grid->addWidget(Label2, 0, 3);
    grid->addWidget(Text2, 0, 4);
    grid->addWidget(Check1, 0, 5);
    grid->addWidget(Option2, 1, 0);
    grid->addWidget(Option3, 2, 0);
    grid->addWidget(Label3, 2, 1);
    grid->addWidget(Combo1, 2, 2);
    grid->setColumnStretch(6, 1);
    for (forms::DatePicker* date : {Text1, Text2})
        date->setFixedWidth(forms::widthFor(date, u"00-00-00000000"));

    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    for (forms::Button* button : {Command1, Command2, Command3}) foot->addWidget(button);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Documentos de todos os associados"_s,
                           u"Para arquivo ou correio eletrónico. Nenhum ficheiro que já exista é "
                           "alterado."_s,
                           u"Label4"_s, u"Label5"_s, u"Image1"_s),
        this);
    body->addWidget(frame);
    body->addLayout(foot);
    body->addStretch(1);
    forms::tabThrough(
        {Option1, Option2, Option3, Text1, Text2, Check1, Combo1, Command1, Command2, Command3});
    Command1->setDefault(true);
    Option1->setFocus();
}

Kind frmDocumentos::kind() const {
    if (Option2->isChecked()) return Kind::Letters;
    return Option3->isChecked() ? Kind::Declarations : Kind::Extracts;
}

void frmDocumentos::showKind() {
    for (QWidget* each : std::initializer_list<QWidget*>{Label1, Label2, Text1, Text2, Check1})
        each->setEnabled(kind() == Kind::Extracts);
    for (QWidget* each : std::initializer_list<QWidget*>{Label3, Combo1})
        each->setEnabled(kind() == Kind::Declarations);
}

documents::Wish frmDocumentos::wish() const {
    return {.kind = kind(),
            .year = Combo1->currentData().toInt(),
            .first = core::toDate(Text1->Value()),
            .last = core::toDate(Text2->Value()),
            .detailed = kind() == Kind::Extracts && Check1->Value()};
}

/// False, with a box that says what is missing.
bool frmDocumentos::isComplete() {
    const documents::Wish wanted = wish();
    QString missing;
    QWidget* field = Text1;
    if (wanted.kind == Kind::Declarations && wanted.year == 0) {
        missing = u"Ainda não há nenhum ano fechado: não há declarações a fazer."_s;
        field = Option3;
    } else if (wanted.kind == Kind::Extracts &&
               !(wanted.first.isValid() && wanted.last.isValid())) {
        missing = u"Tem de preencher os campos da data!"_s;
        field = wanted.first.isValid() ? Text2 : Text1;
    } else if (wanted.kind == Kind::Extracts && wanted.first > wanted.last) {
        missing = u"O último dia é anterior ao primeiro."_s;
    }
    if (missing.isEmpty()) return true;
    core::MsgBox(missing, core::Icon::Information, Caption());
    field->setFocus();
    return false;
}

void frmDocumentos::Command1_Click() {
    if (!isComplete()) return;
    const QString folder =
        QFileDialog::getExistingDirectory(this, u"Pasta para os documentos"_s, documentsFolder());
    if (folder.isEmpty()) return;
    make(folder, [&](const documents::GoesOn& goesOn) {
        return documents::writeEach(wish(), book_, folder, goesOn);
    });
}

void frmDocumentos::Command2_Click() {
    if (!isComplete()) return;
    const QString file = QFileDialog::getSaveFileName(this, u"Guardar um só PDF"_s,
                                                      documentsFolder(), u"Documento PDF (*.pdf)"_s,
                                                      nullptr, QFileDialog::DontConfirmOverwrite);
    if (file.isEmpty()) return;
    make(file, [&](const documents::GoesOn& goesOn) {
        return documents::writeTogether(wish(), book_, file, goesOn);
    });
}

void frmDocumentos::make(const QString& where, const Make& make) {
    constexpr int Percent = 100;
    printing::Progress progress(this, Caption(), u"A fazer os documentos…"_s, Percent);
    const documents::Made made = make([&](qsizetype done, qsizetype all) {
        return progress.show(static_cast<int>(done * Percent / all));
    });
    if (made.documents == 0)
        core::MsgBox(u"Não há documentos a fazer."_s, core::Icon::Information, Caption());
    else if (made.isWhole)
        core::MsgBox(u"Feito, com %1:\n%2"_s.arg(counted(made.documents), where),
                     core::Icon::Information, Caption());
    else
        core::MsgBox(
            u"Cancelado. Ficheiros que já estavam feitos ficam na pasta; um só PDF não se faz a "
            "meio."_s,
            core::Icon::Exclamation, Caption());
}

}  // namespace host
