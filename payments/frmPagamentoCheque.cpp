// SPDX-License-Identifier: MIT
#include "payments/frmPagamentoCheque.h"

#include <QBoxLayout>
#include <QPointer>

#include "payments/ChequeNumber.h"
#include "platform/forms/SmallScreen.h"

using namespace Qt::StringLiterals;

namespace payments {

frmPagamentoCheque::frmPagamentoCheque(const ado::RecordsetPtr& movement, const QString& number)
    : Form(u"frmPagamentoCheque"_s, u"Pagamento por Cheque"_s),
      movement_(movement),
      Text1(new forms::TextBox(u"Text1"_s)),
      Command1(new forms::Button(u"Command1"_s, u"&OK"_s)),
      Command2(new forms::Button(u"Command2"_s, QString())),
      Command3(new forms::Button(u"Command3"_s, QString())) {
    layOut();
    Text1->setText(number);
    Text1->SelectAll();
    onBoxClosed = [this](const QString&) { return Text1; };
    Command1->onClick = [this] { Command1_Click(); };
    Command2->onClick = [this] { step(-1); };
    Command3->onClick = [this] { step(1); };
}

void frmPagamentoCheque::ask(const ado::RecordsetPtr& movement) {
    const QPointer<frmPagamentoCheque> screen =
        new frmPagamentoCheque(movement, nextChequeNumber());
    screen->ShowModal();
    if (screen) screen->Unload();
}

void frmPagamentoCheque::layOut() {
    Text1->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    Text1->setAccessibleName(u"Número do cheque"_s);
    Text1->onGotFocus = [this] { Text1->SelectAll(); };
    Command2->setIcon(style()->standardIcon(QStyle::SP_ArrowDown));
    Command2->setToolTip(u"Número anterior"_s);
    Command2->setAccessibleName(u"Número anterior"_s);
    Command3->setIcon(style()->standardIcon(QStyle::SP_ArrowUp));
    Command3->setToolTip(u"Número seguinte"_s);
    Command3->setAccessibleName(u"Número seguinte"_s);

    auto* frame = new forms::Frame(u"Frame1"_s, u"Número Cheque:"_s);
    auto* number = new QHBoxLayout(frame);
    number->addWidget(Text1, 1);
    number->addWidget(Command2);
    number->addWidget(Command3);

    forms::layOutSmallScreen(this, frame, Command1, 320);
}

void frmPagamentoCheque::step(int by) {
    Text1->setText(QString::number(chequeNumber(Text1->Text()) + by));
}

void frmPagamentoCheque::Command1_Click() {
    const qint64 number = chequeNumber(Text1->Text());
    movement_->setCollect(u"cheque"_s, number);
    storeChequeNumber(number);
    Unload();
}

}  // namespace payments
