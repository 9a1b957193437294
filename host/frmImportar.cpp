// SPDX-License-Identifier: MIT
#include "host/frmImportar.h"

#include <QComboBox>
#include <QFileDialog>
#include <QGridLayout>
#include <QLabel>
#include <QStandardPaths>

#include "host/TextTable.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Fields.h"
#include "platform/forms/TextBox.h"
#include "platform/printing/Progress.h"

using namespace Qt::StringLiterals;

namespace host {

using importing::Outcome;

namespace {

/// How far a file is, in thousandths.
class FileProgress {
public:
    FileProgress(QWidget* parent, const QString& text)
        : progress_(parent, u"Importar"_s, text, Steps) {}
    importing::GoesOn goesOn() {
        return [this](qsizetype done, qsizetype of) {
            return progress_.show(int(done * Steps / std::max<qsizetype>(of, 1)));
        };
    }

private:
    static constexpr int Steps = 1000;
    printing::Progress progress_;
};

}  // namespace

frmImportar::frmImportar(const database::BookPlace& place)
    : Form(u"frmImportar"_s, u"Importar"_s),
      place_(place),
      Combo1(new QComboBox),
      Text1(forms::textBox(u"Text1"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&Escolher…"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Ver o que acontece"_s)),
      Check1(new forms::CheckBox(u"Check1"_s, u"Só as linhas &recusadas"_s)),
      Check2(new forms::CheckBox(u"Check2"_s, u"Importar &sem as linhas recusadas"_s)),
      Grid1(new TextTable(u"Grid1"_s, {{u"Linha"_s, 8, true},
                                       {u"O que acontece"_s, 16},
                                       {u"Quem ou o quê"_s, 22},
                                       {u"Como"_s, 60}})),
      Label3(new QLabel),
      Command3(new forms::Button(u"Command3"_s, u"&Importar"_s)),
      Command4(new forms::Button(u"Command4"_s, u"&Fechar"_s)) {
    Combo1->setObjectName(u"Combo1"_s);
    for (const importing::Description& each : importing::descriptions())
        Combo1->addItem(each.title, int(each.kind));
    Grid1->setAccessibleName(u"Linhas do ficheiro"_s);
    Label3->setObjectName(u"Label3"_s);
    layOut();
    connect(Combo1, &QComboBox::currentIndexChanged, this, &frmImportar::forget);
    connect(Text1, &QLineEdit::textChanged, this, &frmImportar::forget);
    connect(Check1, &QCheckBox::toggled, this, &frmImportar::showRows);
    connect(Check2, &QCheckBox::toggled, this, &frmImportar::showButtons);
    setCancelButton(Command4);
    letEnterGoOn(Command2);
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Command2_Click(); };
    Command3->onClick = [this] { Command3_Click(); };
    Command4->onClick = [this] { Unload(); };
    forget();
}

void frmImportar::layOut() {
    auto* frame = new forms::Frame(u"Frame1"_s, u"O ficheiro:"_s);
    auto* file = new QGridLayout(frame);
    file->addWidget(forms::fieldLabel(u"&O que traz:"_s, Combo1, u"Label4"_s), 0, 0);
    file->addWidget(Combo1, 0, 1, Qt::AlignLeft);
    file->addWidget(forms::fieldLabel(u"Fi&cheiro:"_s, Text1, u"Label5"_s), 1, 0);
    file->addWidget(Text1, 1, 1);
    file->addWidget(Command1, 1, 2);
    file->addWidget(Command2, 1, 3);
    file->setColumnStretch(1, 1);
    auto* under = new QHBoxLayout;
    under->addWidget(Label3, 1);
    under->addWidget(Check1);
    auto* foot = new QHBoxLayout;
    foot->addWidget(Check2);
    foot->addStretch(1);
    foot->addWidget(Command3);
    foot->addWidget(Command4);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Importar"_s,
                           u"Nada é gravado antes de «Importar»; e então grava-se tudo, ou nada."_s,
                           u"Label1"_s, u"Label2"_s, u"Image1"_s),
        this);
    body->addWidget(frame);
    body->addLayout(under);
    body->addWidget(Grid1, 1);
    body->addLayout(foot);
    const QSize wanted(120 * fontMetrics().averageCharWidth(), 36 * fontMetrics().height());
    resize(wanted.boundedTo(screen()->availableSize()));
    forms::tabThrough(
        {Combo1, Text1, Command1, Command2, Check1, Grid1, Check2, Command3, Command4});
    Combo1->setFocus();
}

importing::Wish frmImportar::wish() const {
    return {importing::Kind(Combo1->currentData().toInt()), Text1->Text().trimmed()};
}

/// What was seen is of another file.
void frmImportar::forget() {
    plan_.reset();
    showRows();
}

void frmImportar::Command1_Click() {
    const QString before = QFileInfo(Text1->Text()).absolutePath();
    const QString folder = Text1->Text().isEmpty()
                               ? QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation)
                               : before;
    const QString chosen = QFileDialog::getOpenFileName(
        this, u"Ficheiro a importar"_s, folder, u"CSV (*.csv *.txt);;Todos os ficheiros (*)"_s);
    if (chosen.isEmpty()) return;
    Text1->setText(QDir::toNativeSeparators(chosen));
    Command2->setFocus();
    Command2_Click();
}

void frmImportar::Command2_Click() {
    if (Text1->Text().trimmed().isEmpty()) {
        core::MsgBox(u"Indique o ficheiro a importar."_s, core::Icon::Information, Caption());
        return Text1->setFocus();
    }
    forget();
    FileProgress progress(this, u"A ler o ficheiro…"_s);
    plan_ = importing::preview(wish(), place_, progress.goesOn());
    showRows();
    if (Command3->isEnabled())
        Command3->setFocus();
    else
        Grid1->setFocus();
}

void frmImportar::showRows() {
    std::vector<QStringList> rows;
    if (plan_)
        for (const importing::PlannedRow& row : plan_->rows)
            if (!Check1->Value() || row.outcome == Outcome::Refused)
                rows.push_back({QString::number(row.line), importing::outcomeText(row.outcome),
                                row.key, row.detail});
    const bool isEmpty = rows.empty();
    Grid1->setRows(std::move(rows));
    if (!isEmpty) Grid1->selectRow(0);
    Label3->setText(plan_ ? plan_->summary() : u"O ficheiro ainda não foi visto."_s);
    showButtons();
}

void frmImportar::showButtons() {
    const qsizetype refused = plan_ ? plan_->count(Outcome::Refused) : 0;
    Check1->setEnabled(refused > 0);
    Check2->setEnabled(refused > 0);
    Command3->setEnabled(plan_ && plan_->hasWork() && (refused == 0 || Check2->Value()));
}

void frmImportar::Command3_Click() {
    const qsizetype refused = plan_->count(Outcome::Refused);
    if (refused > 0 &&
        core::MsgBox(u"Linhas recusadas, que ficam de fora: %1.\nQuer importar as outras?"_s.arg(
                         core::grouped(refused)),
                     core::Icon::Question, Caption(), core::Buttons::YesNo) != core::Answer::Yes)
        return;
    FileProgress progress(this, u"A importar…"_s);
    const auto result = importing::importFile(
        wish(), place_,
        refused > 0 ? importing::Refused::LeaveOut : importing::Refused::WriteNothing, &*plan_,
        progress.goesOn());
    if (!result) {
        core::MsgBox(u"Cancelado: nada foi importado."_s, core::Icon::Information, Caption());
        return;
    }
    hasWritten_ = true;
    core::MsgBox(u"Importado: %1."_s.arg(result->plan.summary()), core::Icon::Information,
                 Caption());
    forget();
    Label3->setText(u"Importado: %1."_s.arg(result->plan.summary()));
    Combo1->setFocus();
}

}  // namespace host
