// SPDX-License-Identifier: MIT
#include "receipts/ReceiptRoute.h"

#include "data/NewMovement.h"
#include "receipts/frmRecebimento.h"
#include "receipts/frmReposicao.h"

namespace receipts {

namespace {

template <class Screen>
void openNew(QString& strConMember, QString& strSQL) {
    const ado::RecordsetPtr rows = data::openNewMovement(strConMember, strSQL);
    forms::closeView<Screen>();
    using Instance = forms::DefaultInstance<Screen>;
    // A registered one stays locked.
    if (Instance::isLoaded() && Instance::get().isRegistered()) Instance::unload();
    Screen& screen = Instance::get();
    if (screen.isVisible()) screen.forgetEntry();
    screen.showNew(rows);
}

template <class Screen>
void showExisting(const ado::RecordsetPtr& rows) {
    forms::closeView<Screen>();
    Screen& screen = forms::DefaultInstance<Screen>::get();
    screen.showReadOnly(rows);
    screen.Show();
}

template <class Screen>
bool isUnderWay() {
    return forms::DefaultInstance<Screen>::isLoaded() &&
           forms::DefaultInstance<Screen>::get().isUnderWay();
}

}  // namespace

void openNewReceipt(QString& strConMember, QString& strSQL) {
    openNew<frmRecebimento>(strConMember, strSQL);
}

void openNewReposition(QString& strConMember, QString& strSQL) {
    openNew<frmReposicao>(strConMember, strSQL);
}

bool isReceiptUnderWay() {
    return isUnderWay<frmRecebimento>();
}

bool isRepositionUnderWay() {
    return isUnderWay<frmReposicao>();
}

void showReceipt(const ado::RecordsetPtr& rows) {
    showExisting<frmRecebimento>(rows);
}

void showReposition(const ado::RecordsetPtr& rows) {
    showExisting<frmReposicao>(rows);
}

}  // namespace receipts
