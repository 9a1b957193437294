// SPDX-License-Identifier: MIT
#include "companions/search/frmProcurar.h"

#include <QBoxLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QTableView>
#include <QTimer>

#include "companions/search/MemberList.h"
#include "platform/core/Format.h"
#include "platform/forms/Controls.h"
#include "platform/forms/Fields.h"
#include "platform/forms/Look.h"
#include "platform/forms/TextBox.h"

using namespace Qt::StringLiterals;

namespace companions {

int frmProcurar::choose(const ado::ConnectionPtr& connection) {
    int chosen = 0;
    auto* window = new frmProcurar(connection);
    window->taken_ = [&chosen](int socioId) { chosen = socioId; };
    window->ShowModal();
    return chosen;
}

frmProcurar::frmProcurar(const ado::ConnectionPtr& connection)
    : Form(u"frmProcurar"_s, u"Procurar Associado"_s),
      connection_(connection),
      members_(new MemberList(this)),
      txtProcurar(new forms::TextBox(u"txtProcurar"_s, this)),
      lstSocios(new QTableView(this)),
      lblEncontrados(new QLabel(this)),
      cmdActualizar(new forms::Button(u"cmdActualizar"_s, u"Atualizar (F5)"_s, this)),
      cmdEscolher(new forms::Button(u"cmdEscolher"_s, u"&Escolher"_s, this)),
      cmdDesistir(new forms::Button(u"cmdDesistir"_s, u"&Desistir"_s, this)) {
    layOut();
    connectHandlers();
    showMembers();
}

void frmProcurar::layOut() {
    txtProcurar->setMaxLength(200);
    txtProcurar->setPlaceholderText(u"número, ou palavras do nome por qualquer ordem"_s);
    txtProcurar->installEventFilter(this);
    lstSocios->viewport()->installEventFilter(this);

    lstSocios->setObjectName(u"lstSocios"_s);
    lstSocios->setAccessibleName(u"Associados encontrados"_s);
    lstSocios->setModel(members_);
    lstSocios->setFocusPolicy(Qt::NoFocus);
    forms::settleTable(*lstSocios);
    const int character = fontMetrics().averageCharWidth();
    lstSocios->setColumnWidth(MemberList::Number, 15 * character);
    lstSocios->setColumnWidth(MemberList::ShortName, 26 * character);
    lstSocios->setColumnWidth(MemberList::Locality, 24 * character);
    lstSocios->setColumnWidth(MemberList::Enrolled, 12 * character);
    lstSocios->horizontalHeader()->setSectionResizeMode(MemberList::Name, QHeaderView::Stretch);

    lblEncontrados->setObjectName(u"lblEncontrados"_s);
    cmdEscolher->setDefault(true);
    cmdActualizar->setShortcut(Qt::Key_F5);
    setCancelButton(cmdDesistir);

    auto* search = new QHBoxLayout;
    search->addWidget(forms::fieldLabel(u"&Procurar:"_s, txtProcurar, u"lblProcurar"_s));
    search->addWidget(txtProcurar, 1);
    auto* buttons = new QHBoxLayout;
    buttons->addWidget(lblEncontrados, 1);
    for (auto* button : {cmdActualizar, cmdEscolher, cmdDesistir}) buttons->addWidget(button);

    QVBoxLayout* body = forms::bodyUnder(
        forms::headingBand(
            u"Procurar Associado"_s,
            u"Escreva o início do número ou de palavras do nome; as setas percorrem a lista."_s,
            u"lblTitulo"_s, u"lblExplicacao"_s, u"picTitulo"_s),
        this);
    body->addLayout(search);
    body->addWidget(lstSocios, 1);
    body->addLayout(buttons);
    resize(130 * character, 32 * fontMetrics().height());
}

void frmProcurar::connectHandlers() {
    connect(txtProcurar, &QLineEdit::textChanged, this, &frmProcurar::filter);
    connect(lstSocios, &QTableView::doubleClicked, this, &frmProcurar::take);
    cmdActualizar->onClick = [this] { reload(); };
    cmdEscolher->onClick = [this] { take(); };
    cmdDesistir->onClick = [this] { Unload(); };
}

void frmProcurar::showMembers() {
    const auto before = MemberIndex::lastRead(connection_);
    isOutdated_ = before != nullptr;
    members_->setMembers(before ? before : MemberIndex::read(connection_));
    filter();
    txtProcurar->setFocus();
}

/// A mark that was moved stays where it is.
void frmProcurar::reload() {
    const int marked = lstSocios->currentIndex().row();
    const qint32 socioId = marked > 0 ? members_->socioId(marked) : 0;
    members_->setMembers(MemberIndex::read(connection_));
    isOutdated_ = false;
    filter();
    if (const int row = members_->rowOf(socioId); row > 0) lstSocios->selectRow(row);
    txtProcurar->setFocus();
}

void frmProcurar::filter() {
    members_->setFilter(txtProcurar->Text());
    const int found = members_->rowCount();
    lstSocios->selectRow(0);
    cmdEscolher->setEnabled(found > 0);
    const QLocale locale = core::userLocale();
    lblEncontrados->setText(
        u"%1 de %2 associados"_s.arg(locale.toString(found), locale.toString(members_->total())));
}

/// Nobody is taken by what was read for an earlier window.
void frmProcurar::take() {
    if (isOutdated_) reload();
    const QModelIndex current = lstSocios->currentIndex();
    if (!current.isValid()) return;
    taken_(members_->socioId(current.row()));
    Unload();
}

bool frmProcurar::eventFilter(QObject* watched, QEvent* event) {
    if (watched == lstSocios->viewport() && event->type() == QEvent::Paint && !isPainted_) {
        isPainted_ = true;
        QTimer::singleShot(0, this, [this] {
            forms::handle([this] {
                if (isOutdated_) reload();
            });
        });
    }
    if (watched != txtProcurar || event->type() != QEvent::KeyPress)
        return Form::eventFilter(watched, event);
    switch (static_cast<QKeyEvent*>(event)->key()) {
        case Qt::Key_Up:
        case Qt::Key_Down:
        case Qt::Key_PageUp:
        case Qt::Key_PageDown:
            QCoreApplication::sendEvent(lstSocios, event);
            return true;
        default:
            return Form::eventFilter(watched, event);
    }
}

}  // namespace companions
