// SPDX-License-Identifier: MIT
#include "payments/frmBanca.h"

#include <QCloseEvent>
#include <QGridLayout>
#include <QLabel>
#include <QStyle>

#include "boundary/environment/dtZelmars.h"
#include "platform/automation/Automation.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/forms/Emblem.h"
#include "platform/forms/Fields.h"
#include "platform/forms/Undisturbed.h"

using namespace Qt::StringLiterals;

namespace payments {

namespace {

// How long is waited, in milliseconds: the bank's program is given time, and nothing else paces the
// run. 0 stops a timer.
constexpr int Stopped = 0;
constexpr int AfterStart = 1000;
constexpr int UntilThere = 2000;
constexpr int BeforeEnter = 3000;
constexpr int BetweenModules = 9999;
constexpr int BeforeTransfers = 1000;

const QString Leave = u"&Sair"_s;

QLabel* picture(const QString& name, const QPixmap& image) {
    auto* label = new QLabel;
    label->setObjectName(name);
    label->setPixmap(image);
    QSizePolicy policy = label->sizePolicy();
    policy.setRetainSizeWhenHidden(true);
    label->setSizePolicy(policy);
    label->hide();
    return label;
}

}  // namespace

frmBanca::frmBanca()
    : Form(u"frmBanca"_s, u"Banca Eletrónica"_s),
      steps_(new forms::Frame(u"Frame1"_s, u"Operações a Efectuar"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&Continuar >"_s)),
      OKButton(new forms::Button(u"OKButton"_s, u"&Abortar"_s)),
      Timer1(new forms::Timer(u"Timer1"_s, Stopped, this)),
      Timer2(new forms::Timer(u"Timer2"_s, Stopped, this)),
      Timer3(new forms::Timer(u"Timer3"_s, Stopped, this)) {
    layOut();
    mark(open_, true);
    Timer1->onTimer = [this] { Timer1_Timer(); };
    Timer2->onTimer = [this] { Timer2_Timer(); };
    Timer3->onTimer = [this] { Timer3_Timer(); };
    for (forms::Timer* timer : {Timer1, Timer2, Timer3}) timer->setEnabled(true);
    Command1->onClick = [this] { Command1_Click(); };
    OKButton->onClick = [this] { OKButton_Click(); };
    setCancelButton(OKButton);
    onUnload = [this] {
        for (forms::Timer* timer : {Timer1, Timer2, Timer3}) timer->setEnabled(false);
    };
}

void frmBanca::layOut() {
    auto* grid = new QGridLayout(steps_);
    grid->setColumnStretch(2, 1);
    open_ = addStep(u"Label1"_s, u"Abrir a Aplicação da Banca Eletrónica"_s, u"Picture4"_s,
                    u"Picture3"_s);
    login_ = addStep(u"Label2"_s, u"Validar utilizador na Banca Eletrónica"_s, u"Picture6"_s,
                     u"Picture5"_s);
    interbank_ = addStep(u"Label3"_s, u"Abrir o módulo de Transferências Interbancárias"_s,
                         u"Picture8"_s, u"Picture7"_s);
    internal_ = addStep(u"Label6"_s, u"Abrir o módulo de Transferências Internas"_s, u"Picture13"_s,
                        u"Picture14"_s);
    numbers_ =
        addStep(u"Label4"_s, u"Regularizar a listagem de NIBs"_s, u"Picture10"_s, u"Picture9"_s);
    transfers_ = addStep(u"Label5"_s, u"Processar as Transferências Bancárias"_s, u"Picture12"_s,
                         u"Picture11"_s);

    auto* foot = new QHBoxLayout;
    for (const auto& name : {u"Picture1"_s, u"Picture2"_s})
        foot->addWidget(picture(name, forms::emblem(16, palette().color(QPalette::Mid))));
    foot->addStretch(1);
    foot->addWidget(Command1);
    foot->addWidget(OKButton);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(u"Banca Eletrónica"_s,
                           u"As transferências são escritas no programa do banco. Não use o "
                           "teclado nem o rato entretanto."_s,
                           u"Label7"_s, u"Label8"_s, u"Image1"_s),
        this);
    body->addWidget(steps_);
    body->addLayout(foot);
    body->addStretch(1);
    Command1->setDefault(true);
    forms::tabThrough({Command1, OKButton});
    Command1->setFocus();
}

/// A step has a second picture beside its row, which no step ever shows, as the two at the foot.
frmBanca::Step frmBanca::addStep(const QString& label, const QString& caption,
                                 const QString& marker, const QString& unused) {
    const QPixmap arrow = style()->standardIcon(QStyle::SP_ArrowRight).pixmap(16, 16);
    auto* grid = static_cast<QGridLayout*>(steps_->layout());
    const int row = grid->rowCount();
    const Step step{new QLabel(caption), picture(marker, arrow)};
    step.label->setObjectName(label);
    grid->addWidget(step.marker, row, 0);
    grid->addWidget(picture(unused, arrow), row, 1);
    grid->addWidget(step.label, row, 2);
    return step;
}

// --- The steps

bool frmBanca::isAt(const Step& step) const {
    return step.label->font().bold();
}

void frmBanca::mark(const Step& step, bool isCurrent) {
    QFont font = step.label->font();
    font.setBold(isCurrent);
    step.label->setFont(font);
    step.marker->setVisible(isCurrent);
}

void frmBanca::move(const Step& from, const Step& to) {
    mark(from, false);
    mark(to, true);
}

void frmBanca::Command1_Click() {
    if (isAt(open_))
        openBank();
    else if (isAt(login_))
        waitForLogin();
    else if (isAt(interbank_))
        openModule(bank::InterbankModule.toString(), Timer2);
    else if (isAt(internal_))
        openModule(bank::InternalModule.toString(), Timer3);
    else if (isAt(numbers_))
        typeTransfers();
}

// A tick does nothing while another handler of the screen runs, as that of "&Abortar" does while
// its question is open: no key may go to the bank behind the operator's back. It comes again.
void frmBanca::Timer1_Timer() {
    const forms::Turn turn(this);
    if (turn) Command1_Click();
}

void frmBanca::openBank() {
    Timer1->setInterval(Stopped);
    move(open_, login_);
    automation::AppActivate(automation::Shell(bank::Program.toString()));
    for (const auto& keys : {u"%f"_s, u"{DOWN}"_s, u"{ENTER}"_s}) automation::SendKeys(keys);
    Timer1->setInterval(AfterStart);
}

/// The operator logs in by himself, and the main window comes up only then.
void frmBanca::waitForLogin() {
    try {
        automation::AppActivate(bank::MainWindow.toString());
    } catch (const core::Failure&) {
        Timer1->setInterval(UntilThere);
        return;
    }
    Timer1->setInterval(Stopped);
    move(login_, interbank_);
    Timer1->setInterval(UntilThere);
}

/// @param enter  the timer that confirms the code
void frmBanca::openModule(const QString& code, forms::Timer* enter) {
    Timer1->setInterval(Stopped);
    try {
        bank::typeModule(code);
    } catch (const core::Failure&) {
        Timer1->setInterval(UntilThere);
        return;
    }
    enter->setInterval(BeforeEnter);
}

void frmBanca::Timer2_Timer() {
    const forms::Turn turn(this);
    if (!turn) return;
    Timer2->setInterval(Stopped);
    automation::SendKeys(u"{ENTER}"_s);
    Timer1->setInterval(Stopped);
    move(interbank_, internal_);
    Timer1->setInterval(BetweenModules);
}

void frmBanca::Timer3_Timer() {
    const forms::Turn turn(this);
    if (!turn) return;
    Timer3->setInterval(Stopped);
    automation::SendKeys(u"{ENTER}"_s);
    Timer1->setInterval(Stopped);
    move(internal_, numbers_);
    Timer1->setInterval(BeforeTransfers);
}

/// Intentional: a failure in the midst of the rows ends this without a message. Before the first
/// window was found the timer still runs, and it all begins anew at the next tick; later it is
/// stopped, and "&Continuar >" types all rows from the first one on again.
void frmBanca::typeTransfers() {
    forms::Undisturbed undisturbed;
    const ado::RecordsetPtr rows = ado::Recordset::create();
    try {
        rows->Open(query_, environment::dtZelmars::instance().MSAccess());
    } catch (...) {
        // The next try is the operator's: one box is enough.
        Timer1->setInterval(Stopped);
        throw;
    }
    while (!rows->atEnd()) {
        try {
            bank::typeTransfer(*rows, [this] { Timer1->setInterval(Stopped); });
            rows->MoveNext();
        } catch (const core::Failure&) {
            // A press on "&Abortar" that came meanwhile is the way out of a wait without end.
            undisturbed.end();
            return;
        }
        undisturbed.serve();
    }
    finish();
    rows->Close();
    update();
}

void frmBanca::finish() {
    // There may have been no row that stopped it.
    Timer1->setInterval(Stopped);
    move(numbers_, transfers_);
    mark(transfers_, false);
    OKButton->setCaption(Leave);
    OKButton->setFocus();
    Command1->hide();
}

// --- Leaving

void frmBanca::OKButton_Click() {
    if (OKButton->Caption() == Leave) {
        core::passingOver([this] { Unload(); });
        // The screens that were left bring the main window to the front, and that is not wanted.
        forms::afterwards([] {
            core::passingOver([] { automation::AppActivate(bank::InterbankWindow.toString()); });
        });
        return;
    }
    if (core::MsgBox(u"Deseja abortar o processamento da banca eletrónica"_s, core::Icon::Question,
                     Caption(), core::Buttons::YesNo) == core::Answer::Yes)
        Unload();
}

/// The window's own button asks as "&Abortar" does.
void frmBanca::closeEvent(QCloseEvent* event) {
    OKButton->click();
    event->setAccepted(isUnloaded());
}

}  // namespace payments
