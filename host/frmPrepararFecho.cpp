// SPDX-License-Identifier: MIT
#include "host/frmPrepararFecho.h"

#include <QBoxLayout>
#include <QGridLayout>
#include <QStandardPaths>

#include "data/RowSets.h"
#include "database/Backup.h"
#include "host/Beside.h"
#include "host/RulesConnection.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"
#include "platform/forms/Fields.h"
#include "platform/printing/DataReport.h"
#include "reports/BalanceLists.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

const QString Debts = u"Dívidas que passam ao novo ano"_s;
const QString Vanishing = u"Saldos que não passam ao novo ano"_s;

/// "12 associados, € 1.234,56"
QString sumOf(const QString& query) {
    const ado::RecordsetPtr rows = data::openToRead(query);
    qint64 count = 0;
    double sum = 0;
    for (; !rows->atEnd(); rows->MoveNext(), ++count)
        sum += core::toDouble(rows->Collect(u"saldo"_s));
    return u"%1 associados, %2"_s.arg(core::grouped(count),
                                      core::formatted(sum, core::format::Money));
}

/// A name that tells what is in it and when it was made; beside the person's documents.
QString proposedFile() {
    const QString folder = QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation);
    return QDir(folder).filePath(u"zelmars-antes-do-fecho-%1-%2.copia"_s.arg(
        core::today().toString(Qt::ISODate), QTime::currentTime().toString(u"HHmm"_s)));
}

}  // namespace

frmPrepararFecho::frmPrepararFecho()
    : Form(u"frmPrepararFecho"_s, u"Preparar o fecho do ano"_s),
      Check1(new forms::CheckBox(u"Check1"_s, u"Fechar &mesmo assim"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&Fazer a cópia e continuar"_s)),
      Command2(new forms::Button(u"Command2"_s, u"&Cancelar"_s)),
      Command3(new forms::Button(u"Command3"_s, u"Ver &dívidas…"_s)),
      Command4(new forms::Button(u"Command4"_s, u"Ver &saldos…"_s)),
      Command5(new forms::Button(u"Command5"_s, u"Ver &verificação…"_s)),
      Command6(new forms::Button(u"Command6"_s, u"Ver de &novo"_s)) {
    layOut();
    setCancelButton(Command2);
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { Unload(); };
    Command3->onClick = [this] { showBalances(reports::carriedDebtsQuery(), Debts); };
    Command4->onClick = [this] { showBalances(reports::vanishingBalancesQuery(), Vanishing); };
    Command5->onClick = [this] {
        auto* shown = new frmVerificacao(check_);
        shown->ShowModal();
    };
    Command6->onClick = [this] { lookAtOthers(); };
    lookAtBook();
    lookAtOthers();
}

forms::TextBox* frmPrepararFecho::addLine(QGridLayout* grid, const QString& label,
                                          const QString& name, forms::Button* button) {
    const int row = grid->rowCount();
    forms::TextBox* box = forms::displayBox(name);
    grid->addWidget(forms::fieldLabel(label, box), row, 0);
    grid->addWidget(box, row, 1);
    if (button) grid->addWidget(button, row, 2);
    return box;
}

void frmPrepararFecho::layOut() {
    auto* grid = new QGridLayout;
    grid->setColumnStretch(1, 1);
    Text7 = addLine(grid, u"Ano a fechar:"_s, u"Text7"_s);
    Text1 = addLine(grid, u"Passam ao histórico:"_s, u"Text1"_s);
    Text2 = addLine(grid, u"Dívidas que passam ao novo ano:"_s, u"Text2"_s, Command3);
    Text3 = addLine(grid, u"Saldos que não passam:"_s, u"Text3"_s, Command4);
    Text4 = addLine(grid, u"Verificação do livro:"_s, u"Text4"_s, Command5);
    Text5 = addLine(grid, u"Também têm o livro aberto:"_s, u"Text5"_s, Command6);
    grid->addWidget(Check1, grid->rowCount(), 1);
    Text6 = forms::textBox(u"Text6"_s);
    const int last = grid->rowCount();
    grid->addWidget(forms::fieldLabel(u"Cópia de se&gurança:"_s, Text6), last, 0);
    grid->addWidget(Text6, last, 1, 1, 2);
    auto* foot = new QHBoxLayout;
    foot->addStretch(1);
    foot->addWidget(Command1);
    foot->addWidget(Command2);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Preparar o fecho do ano"_s,
                           u"O que o fecho vai fazer, e uma cópia de segurança antes dele."_s,
                           u"Label1"_s, u"Label2"_s, u"Image1"_s),
        this);
    body->addLayout(grid);
    body->addLayout(foot);
    setMinimumWidth(112 * fontMetrics().averageCharWidth());
    forms::tabThrough({Command3, Command4, Command5, Command6, Check1, Text6, Command1, Command2});
    Text6->setFocus();
}

void frmPrepararFecho::lookAtBook() {
    const BookSettings settings = BookSettings::read();
    check_ = checkedBook();
    const RulesConnection connection(settings);
    Text7->setText(u"%1 (pode mudar-se no ecrã do fecho)"_s.arg(core::today().year() - 1));
    Text1->setText(u"%1 movimentos"_s.arg(core::grouped(check_.summary.live.movements)));
    Text2->setText(sumOf(reports::carriedDebtsQuery()));
    Text3->setText(sumOf(reports::vanishingBalancesQuery()));
    Text4->setText(check_.summary.findings == 0
                       ? u"sem erros"_s
                       : u"%1 erros"_s.arg(core::grouped(check_.summary.findings)));
    canBackUp_ = database::canBackUp(settings.place());
    Text6->setText(canBackUp_ ? proposedFile() : QString());
    if (canBackUp_) return;
    Text6->setEnabled(false);
    Text6->setText(u"o programa pg_dump não está instalado nesta máquina"_s);
    Command1->setCaption(u"&Continuar sem cópia"_s);
}

void frmPrepararFecho::lookAtOthers() {
    const QStringList others = database::othersIn(BookSettings::read().place());
    Text5->setText(others.isEmpty() ? u"ninguém"_s : others.join(u", "_s));
    Check1->setVisible(!others.isEmpty());
    if (others.isEmpty()) Check1->setValue(false);
}

void frmPrepararFecho::showBalances(const QString& query, const QString& caption) {
    const RulesConnection connection(BookSettings::read());
    printing::DataReport(reports::balanceList(caption))
        .Show(data::openToRead(query), printing::DataReport::Wait::Modal);
}

void frmPrepararFecho::Command1_Click() {
    lookAtOthers();
    if (Check1->isVisible() && !Check1->Value()) {
        core::MsgBox(
            u"O livro está aberto também por: %1.\n\nO que lançarem durante o fecho pode "
            "perder-se. Peça-lhes que saiam, ou marque «Fechar mesmo assim»."_s.arg(Text5->text()),
            core::Icon::Exclamation, Caption());
        Check1->setFocus();
        return;
    }
    if (canBackUp_) {
        const QString file = Text6->text().trimmed();
        if (!QDir::isAbsolutePath(file)) {
            core::MsgBox(u"Indique o caminho inteiro do ficheiro da cópia de segurança."_s,
                         core::Icon::Information, Caption());
            Text6->setFocus();
            return;
        }
        const database::BookPlace place = BookSettings::read().place();
        beside([&] { database::backUpBook(place, file); });
    }
    mayGoOn_ = true;
    Hide();
}

}  // namespace host
