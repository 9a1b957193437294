// SPDX-License-Identifier: MIT
#include "receipts/ReceiptRoute.h"

#include "data/NewMovement.h"
#include "platform/core/Failure.h"
#include "receipts/frmRecebimento.h"
#include "receipts/frmReposicao.h"

using namespace Qt::StringLiterals;

namespace receipts {

namespace {

template <class Screen>
void openNew(QString& strConMember, QString& strSQL) {
    const ado::RecordsetPtr rows = data::openNewMovement(strConMember, strSQL);
    forms::closeView<Screen>();
    forms::DefaultInstance<Screen>::get().showNew(rows);
}

template <class Screen>
void showExisting(const ado::RecordsetPtr& rows) {
    forms::closeView<Screen>();
    Screen& screen = forms::DefaultInstance<Screen>::get();
    if (screen.isUnderWay())
        throw core::Failure(core::InvalidCall,
                            u"Há um registo por terminar. Termine-o ou cancele-o antes de ver "
                            "outro movimento."_s);
    screen.showReadOnly(rows);
    screen.Show();
}

}  // namespace

void openNewReceipt(QString& strConMember, QString& strSQL) {
    openNew<frmRecebimento>(strConMember, strSQL);
}

void openNewReposition(QString& strConMember, QString& strSQL) {
    openNew<frmReposicao>(strConMember, strSQL);
}

void showReceipt(const ado::RecordsetPtr& rows) {
    showExisting<frmRecebimento>(rows);
}

void showReposition(const ado::RecordsetPtr& rows) {
    showExisting<frmReposicao>(rows);
}

}  // namespace receipts
