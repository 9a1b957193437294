// SPDX-License-Identifier: MIT
#include "companions/vorlane/frmProgresso.h"

#include <QApplication>
#include <QBoxLayout>
#include <QLabel>
#include <algorithm>

#include "platform/forms/Controls.h"
#include "platform/forms/Fields.h"
#include "platform/forms/Form.h"
#include "platform/forms/MsgBoxes.h"

using namespace Qt::StringLiterals;

namespace vorlane {
namespace {

// The eye sees no more steps than these; work of a few milliseconds is not held up by its bar.
constexpr qint64 MillisecondsBetweenPaints = 30;

QPoint middleOf(const QWidget* screen) {
    return screen ? screen->frameGeometry().center()
                  : QApplication::primaryScreen()->availableGeometry().center();
}

}  // namespace

// A window of the tool-tip kind is the one kind that no desktop activates when it appears: the
// screen below keeps its focus, and with it the field that the operator is in.
frmProgresso::frmProgresso(int total, const QString& message, const QString& title)
    : QFrame(nullptr, Qt::ToolTip), ProgressBar1(new forms::ProgressBar(u"ProgressBar1"_s, this)) {
    forms::install();
    setObjectName(u"frmProgresso"_s);
    setWindowTitle(title);
    setAttribute(Qt::WA_ShowWithoutActivating);
    setFrameShape(QFrame::StyledPanel);
    ProgressBar1->setMaximum(total);
    layOut(message, title);
    show();
    paintNow();
}

void frmProgresso::layOut(const QString& message, const QString& title) {
    auto* lblMensagem = new QLabel(message, this);
    lblMensagem->setObjectName(u"lblMensagem"_s);
    lblMensagem->setBuddy(ProgressBar1);
    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(title, {}, u"lblTitulo"_s, u"lblExplicacao"_s, u"picTitulo"_s), this);
    body->addWidget(lblMensagem);
    body->addWidget(ProgressBar1);
    setMinimumWidth(60 * fontMetrics().averageCharWidth());
    // The toolkit's own way would keep it to a part of the display, and cut the message.
    resize(layout()->totalSizeHint().expandedTo(minimumSize()));
    move(middleOf(QApplication::activeWindow()) - rect().center());
}

void frmProgresso::advance(int steps) {
    const int value = ProgressBar1->value() + steps;
    ProgressBar1->setUpdatesEnabled(false);  // or the bar would paint itself at every step
    ProgressBar1->setValue(std::clamp(value, ProgressBar1->minimum(), ProgressBar1->maximum()));
    ProgressBar1->setUpdatesEnabled(true);
    if (painted_.hasExpired(MillisecondsBetweenPaints)) paintNow();
}

void frmProgresso::paintNow() {
    QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents |
                                    QEventLoop::ExcludeSocketNotifiers);
    repaint();
    painted_.start();
}

}  // namespace vorlane
