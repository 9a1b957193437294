// SPDX-License-Identifier: MIT
#include "host/frmFicheiroBanco.h"

#include <QComboBox>
#include <QFileDialog>
#include <QFileInfo>
#include <QGridLayout>
#include <QMessageBox>
#include <QPushButton>
#include <QStandardPaths>
#include <QTabWidget>

#include "host/Beside.h"
#include "host/BookSettings.h"
#include "host/TextTable.h"
#include "platform/core/Clock.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

using bankfile::Batch;
using bankfile::PayingAccount;
using bankfile::shownAmount;

constexpr std::size_t LinesShown = 12;  ///< a box with more would not fit the screen

/// "12 transferências, € 1.234,56"
QString counted(std::size_t count, core::Money sum) {
    const QString what = count == 1 ? u"transferência"_s : u"transferências"_s;
    return u"%1 %2, %3"_s.arg(core::grouped(static_cast<qint64>(count)), what, shownAmount(sum));
}

/// Of one that was begun, whether the file is there decides what a person does.
QString stateOf(const bankfile::SentFile& sent) {
    if (sent.isDone) return u"feito"_s;
    return QFile::exists(sent.file) ? u"por acabar: o ficheiro existe"_s
                                    : u"por acabar: o ficheiro não existe"_s;
}

/// Beside the person's documents, by the moment at which it is made.
QString proposedFile() {
    const QString folder = QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation);
    return QDir(folder).filePath(u"transferencias-%1-%2.xml"_s.arg(
        core::today().toString(u"yyyyMMdd"_s), QTime::currentTime().toString(u"HHmm"_s)));
}

}  // namespace

frmFicheiroBanco::frmFicheiroBanco()
    : Form(u"frmFicheiroBanco"_s, u"Ficheiro para o banco"_s),
      Text1(new forms::DatePicker(u"Text1"_s)),
      Text2(new forms::DatePicker(u"Text2"_s)),
      Text3(forms::textBox(u"Text3"_s)),
      Text4(forms::textBox(u"Text4"_s)),
      Text5(forms::textBox(u"Text5"_s)),
      Text6(forms::textBox(u"Text6"_s)),
      Combo1(new QComboBox),
      Command1(new forms::Button(u"Command1"_s, u"&Mostrar"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Gravar ficheiro…"_s)),
      Command3(new forms::Button(u"Command3"_s, u"&Fechar"_s)),
      Command4(new forms::Button(u"Command4"_s, u"Guardar c&onta"_s)),
      Tab1(new QTabWidget),
      Table1(new TextTable(u"Table1"_s, {{u"Nº KOR"_s, 9},
                                         {u"Nome"_s, 28},
                                         {u"IBAN"_s, 27},
                                         {u"Montante"_s, 14, true},
                                         {u"Referência"_s, 36}})),
      Table2(new TextTable(u"Table2"_s, {{u"Nº KOR"_s, 9},
                                         {u"Nome"_s, 28},
                                         {u"NIB"_s, 27},
                                         {u"Montante"_s, 14, true},
                                         {u"Porquê"_s, 36}})),
      Table3(new TextTable(u"Table3"_s, {{u"Quando"_s, 17},
                                         {u"Quem"_s, 10},
                                         {u"Ficheiro"_s, 46},
                                         {u"Quantas"_s, 9, true},
                                         {u"Soma"_s, 14, true},
                                         {u"Estado"_s, 24}})),
      Label1(new QLabel),
      Label2(new QLabel) {
    layOut();
    setCancelButton(Command3);
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Command2_Click(); };
    Command3->onClick = [this] { Unload(); };
    Command4->onClick = [this] { Command4_Click(); };
    for (forms::DatePicker* date : {Text1, Text2}) {
        date->setValue(core::fromDate(core::today()));
        date->onGotFocus = [date] { date->SelectAll(); };
    }
    showAccount(PayingAccount::read());
    showFiles();
    show(read());
}

forms::Frame* frmFicheiroBanco::daysFrame() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"Data das transferências:"_s);
    auto* row = new QHBoxLayout(frame);
    row->addWidget(forms::fieldLabel(u"&De"_s, Text1, u"Label3"_s));
    row->addWidget(Text1);
    row->addWidget(forms::fieldLabel(u"&a"_s, Text2, u"Label4"_s));
    row->addWidget(Text2);
    row->addWidget(Command1);
    row->addStretch(1);
    for (forms::DatePicker* date : {Text1, Text2})
        date->setFixedWidth(forms::widthFor(date, u"00-00-00000000"));
    return frame;
}

forms::Frame* frmFicheiroBanco::accountFrame() {
    auto* frame = new forms::Frame(u"Frame2"_s, u"Conta que paga:"_s);
    QGridLayout* grid = forms::pairsIn(frame, {u"NIB ou IBAN:", u"Identificação:"});
    Combo1->setObjectName(u"Combo1"_s);
    for (const auto version : {bankfile::Version::V09, bankfile::Version::V03})
        Combo1->addItem(u"pain.001.001."_s + nameOf(version), nameOf(version));
    forms::addPair(grid, 0, 0, u"&NIB ou IBAN:"_s, Text3, u"Label5"_s);
    forms::addPair(grid, 0, 1, u"&BIC:"_s, Text6, u"Label8"_s);
    forms::addPair(grid, 1, 0, u"Nome da o&rganização:"_s, Text4, u"Label6"_s);
    forms::addPair(grid, 1, 1, u"&Identificação:"_s, Text5, u"Label7"_s);
    forms::addPair(grid, 2, 0, u"&Versão do ficheiro:"_s, Combo1, u"Label9"_s);
    grid->addWidget(Command4, 2, 3, Qt::AlignRight);
    Text6->setPlaceholderText(u"não é preciso"_s);
    return frame;
}

void frmFicheiroBanco::layOut() {
    auto* transfers = new QWidget;
    auto* column = new QVBoxLayout(transfers);
    for (QLabel* label : {Label1, Label2}) label->setTextFormat(Qt::PlainText);
    Label1->setObjectName(u"Label1"_s);
    Label2->setObjectName(u"Label2"_s);
    column->addWidget(Label1);
    column->addWidget(Table1, 3);
    column->addWidget(Label2);
    column->addWidget(Table2, 2);
    Table1->setAccessibleName(u"Transferências que vão no ficheiro"_s);
    Table2->setAccessibleName(u"Transferências que não podem ir"_s);
    Table3->setAccessibleName(u"Ficheiros feitos"_s);
    Tab1->setObjectName(u"Tab1"_s);
    Tab1->setAccessibleName(u"Transferências e ficheiros"_s);
    Tab1->addTab(transfers, u"&Transferências"_s);
    Tab1->addTab(Table3, u"Ficheiros feito&s"_s);
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    foot->addWidget(Command2);
    foot->addWidget(Command3);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Ficheiro para o banco"_s,
                           u"As transferências da listagem de pagamentos, num ficheiro SEPA."_s,
                           u"Label25"_s, u"Label26"_s, u"Image1"_s),
        this);
    for (forms::Frame* frame : {daysFrame(), accountFrame()}) {
        frame->setSizePolicy(QSizePolicy::Preferred, QSizePolicy::Fixed);  // the tables grow
        body->addWidget(frame);
    }
    body->addWidget(Tab1, 1);
    body->addLayout(foot);
    resize(172 * fontMetrics().averageCharWidth(), 48 * fontMetrics().height());
    forms::tabThrough({Text1, Text2, Command1, Text3, Text6, Text4, Text5, Combo1, Command4, Tab1,
                       Table1, Table2, Table3, Command2, Command3});
    Command1->setDefault(true);
    Text1->setFocus();
}

void frmFicheiroBanco::showAccount(const PayingAccount& account) {
    Text3->setText(account.number);
    Text4->setText(account.name);
    Text5->setText(account.identifier);
    Text6->setText(account.bic);
    Combo1->setCurrentIndex(Combo1->findData(nameOf(account.version)));
}

PayingAccount frmFicheiroBanco::typedAccount() const {
    PayingAccount account{.number = Text3->text().trimmed(),
                          .name = Text4->text().trimmed(),
                          .identifier = Text5->text().trimmed(),
                          .bic = Text6->text().trimmed().toUpper()};
    bankfile::readVersion(Combo1->currentData().toString(), account.version);
    return account;
}

/// False, with what is wrong in a box and nothing kept, when no file can be made from it.
bool frmFicheiroBanco::keepAccount() {
    const PayingAccount account = typedAccount();
    const QStringList faults = account.faults();
    if (!faults.isEmpty()) {
        core::MsgBox(faults.join(u'\n'), core::Icon::Exclamation, Caption());
        Text3->setFocus();
        return false;
    }
    if (account != PayingAccount::read()) account.write();
    return true;
}

bool frmFicheiroBanco::haveDays() {
    const QDate first = core::toDate(Text1->Value());
    const QDate last = core::toDate(Text2->Value());
    if (first.isValid() && last.isValid() && first <= last) return true;
    const bool areThere = first.isValid() && last.isValid();
    core::MsgBox(areThere ? u"O último dia é anterior ao primeiro."_s
                          : u"Tem de preencher os campos da data!"_s,
                 core::Icon::Information, Caption());
    (first.isValid() ? Text2 : Text1)->setFocus();
    return false;
}

Batch frmFicheiroBanco::read() const {
    const QString book = BookSettings::read().connectionString();
    const QDate first = core::toDate(Text1->Value());
    const QDate last = core::toDate(Text2->Value());
    Batch batch;
    beside([&] { batch = bankfile::batchOf(bankfile::readTransferRows(book, first, last)); });
    return batch;
}

void frmFicheiroBanco::show(Batch batch) {
    batch_ = std::move(batch);
    std::vector<QStringList> goes;
    for (const bankfile::Payment& each : batch_.payments)
        goes.push_back(
            {each.row.staffNumber, each.name, each.iban, shownAmount(each.amount), each.reference});
    std::vector<QStringList> refused;
    for (const bankfile::Refused& each : batch_.refused)
        refused.push_back({each.row.staffNumber, each.row.name, each.row.nib,
                           shownAmount(each.row.amount), each.why});
    Table1->setRows(std::move(goes));
    Table2->setRows(std::move(refused));
    Label1->setText(u"Vão no ficheiro: "_s + counted(batch_.payments.size(), batch_.sum()) +
                    bankfile::shownRounding(batch_.payments));
    Label2->setText(u"Não podem ir: "_s + counted(batch_.refused.size(), batch_.refusedSum()));
}

void frmFicheiroBanco::showFiles() {
    std::vector<QStringList> rows;
    for (const bankfile::SentFile& sent : bankfile::SentTransfers().files())
        rows.push_back({sent.when.toString(u"dd-MM-yyyy HH:mm"_s), sent.who, sent.file,
                        core::grouped(static_cast<qint64>(sent.transfers.size())),
                        shownAmount(sent.sum()), stateOf(sent)});
    Table3->setRows(std::move(rows));
}

void frmFicheiroBanco::Command1_Click() {
    if (!haveDays()) return;
    show(read());
    Tab1->setCurrentIndex(0);
}

void frmFicheiroBanco::Command4_Click() {
    if (keepAccount()) core::MsgBox(u"A conta foi guardada."_s, core::Icon::Information, Caption());
}

/// What goes into a file is what the person has seen: when the book or the days are not those any
/// more, they are shown anew.
bool frmFicheiroBanco::isAsShown() {
    Batch now = read();
    if (now == batch_) return true;
    show(std::move(now));
    Tab1->setCurrentIndex(0);
    core::MsgBox(u"As transferências não são as que estavam à vista. Veja-as, e grave outra vez."_s,
                 core::Icon::Exclamation, Caption());
    return false;
}

bool frmFicheiroBanco::goesWithoutRefused() {
    if (batch_.refused.empty()) return true;
    return core::MsgBox(
               u"Não podem ir: %1.\nPorquê, está na segunda lista.\n\nFazer o ficheiro sem elas?"_s
                   .arg(counted(batch_.refused.size(), batch_.refusedSum())),
               core::Icon::Question, Caption(), core::Buttons::NoYes) == core::Answer::Yes;
}

bankfile::Repetition frmFicheiroBanco::askRepetition(
    const std::vector<bankfile::Repeated>& repeated) {
    QString lines;
    for (std::size_t at = 0; at < std::min(repeated.size(), LinesShown); ++at)
        lines += u"• "_s + repeated[at].text() + u'\n';
    if (repeated.size() > LinesShown)
        lines += u"… e mais %1.\n"_s.arg(repeated.size() - LinesShown);
    QMessageBox question(
        QMessageBox::Warning, Caption(),
        u"Há movimentos que já foram para um ficheiro:\n\n%1\nSe esse ficheiro foi para o banco e "
        "forem outra vez, são pagos duas vezes."_s.arg(lines),
        QMessageBox::Yes | QMessageBox::Apply | QMessageBox::No, this);
    question.setTextFormat(Qt::PlainText);
    question.button(QMessageBox::Yes)->setText(u"&Deixar de fora"_s);
    question.button(QMessageBox::Apply)->setText(u"&Enviar outra vez"_s);
    question.button(QMessageBox::No)->setText(u"&Cancelar"_s);
    question.setDefaultButton(QMessageBox::No);
    question.setEscapeButton(QMessageBox::No);
    const int answer = question.exec();
    activateWindow();  // without a window manager nobody else gives the focus back
    if (answer == QMessageBox::Yes) return bankfile::Repetition::LeaveOut;
    return answer == QMessageBox::Apply ? bankfile::Repetition::SendAgain
                                        : bankfile::Repetition::None;
}

QString frmFicheiroBanco::chosenFile() {
    // A file that is there is refused when it is made, so that nobody is asked about it.
    return QFileDialog::getSaveFileName(this, u"Gravar o ficheiro para o banco"_s, proposedFile(),
                                        u"Ficheiro SEPA (*.xml)"_s, nullptr,
                                        QFileDialog::DontConfirmOverwrite);
}

void frmFicheiroBanco::Command2_Click() {
    if (!haveDays() || !keepAccount() || !isAsShown()) return;
    if (batch_.payments.empty()) {
        core::MsgBox(u"Não há transferências que possam ir num ficheiro."_s,
                     core::Icon::Information, Caption());
        return;
    }
    if (!goesWithoutRefused()) return;
    const QString file = chosenFile();
    if (file.isEmpty()) return;
    const auto made =
        bankfile::makeBankFile({.batch = batch_,
                                .payer = typedAccount(),
                                .book = BookSettings::read().place().shown(),
                                .file = file},
                               [this](const std::vector<bankfile::Repeated>& repeated) {
                                   return askRepetition(repeated);
                               });
    if (!made) return;
    showFiles();
    core::MsgBox(u"Ficheiro feito, com %1:\n%2"_s.arg(counted(made->payments, made->sum), file),
                 core::Icon::Information, Caption());
}

}  // namespace host
