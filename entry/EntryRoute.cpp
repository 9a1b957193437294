// SPDX-License-Identifier: MIT
#include "entry/EntryRoute.h"

#include "data/NewMovement.h"
#include "entry/frmMovimentos.h"
#include "entry/frmMovimentosF.h"
#include "reports/frmExtratos.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using Entry = forms::DefaultInstance<frmMovimentos>;
using Exit = forms::DefaultInstance<frmMovimentosF>;
using Extracts = forms::DefaultInstance<reports::frmExtratos>;
using Choice = frmMovimentosF::Choice;

/// Who an entry was for.
struct Member {
    qint32 id = 0;
    QString number;
    QString name;
};

Member memberOf(const frmMovimentos& entry) {
    return {entry.Socio_ID, entry.memberNumber(), entry.Text2->Text()};
}

void closeEntry() {
    if (Exit::isLoaded()) Exit::get().onChosen = nullptr;
    Exit::unload();
    Entry::unload();
    Extracts::unload();
}

void openAnother(bool bHospital) {
    QString strConMember;
    QString strSQL;
    openNewMovimento(bHospital, strConMember, strSQL);
}

/// Without a member chosen the next entry is an ordinary one, also after a hospital bill.
void continueWithSameMember() {
    const Member member = memberOf(Entry::get());
    const bool bHospital = member.id != 0 && Entry::get().bHospital;
    closeEntry();
    if (member.id != 0) Entry::get().setMember(member.id, member.number, member.name);
    openAnother(bHospital);
}

/// After the extracts there is no entry left, and the next one is an ordinary one.
void continueWithNewMember() {
    const bool bHospital = Entry::isLoaded() && Entry::get().bHospital;
    closeEntry();
    openAnother(bHospital);
}

void offerOtherMember();

void printExtracts() {
    const Member member = memberOf(Entry::get());
    closeEntry();
    reports::frmExtratos& screen = Extracts::get();
    screen.setMember(member.id, member.number, member.name);
    screen.Show_Options = true;
    screen.onClosed = offerOtherMember;
    screen.ShowModal();
}

void follow(Choice choice) {
    switch (choice) {
        case Choice::SameMember:
            continueWithSameMember();
            break;
        case Choice::NewMember:
            continueWithNewMember();
            break;
        case Choice::Extracts:
            printExtracts();
            break;
        case Choice::Leave:
            closeEntry();
            break;
    }
}

/// After an entry was posted or given up, as `outcome` says.
void askHowToGoOn(const QString& outcome) {
    Exit::get().tell(outcome);
    Exit::get().onChosen = follow;
    Exit::get().ShowModal();
}

/// On the way back from the extracts.
void offerOtherMember() {
    Exit::get().offerOtherMember();
    askHowToGoOn({});
}

void showEntry(bool bHospital, const ado::RecordsetPtr& rows) {
    // The form of a hospital entry does not turn back into an ordinary one, and a registered one
    // stays locked.
    if (Entry::isLoaded() &&
        (Entry::get().isRegistered() || (Entry::get().bHospital && !bHospital)))
        Entry::unload();
    frmMovimentos& screen = Entry::get();
    if (screen.isVisible()) screen.forgetEntry();
    screen.bHospital = bHospital;
    if (bHospital) screen.showAsHospital();
    screen.onLeft = askHowToGoOn;
    screen.showNew(rows);
}

}  // namespace

void openNewMovimento(bool bHospital, QString& strConMember, QString& strSQL) {
    try {
        const ado::RecordsetPtr rows = data::openNewMovement(strConMember, strSQL);
        forms::closeView<frmMovimentos>();
        showEntry(bHospital, rows);
    } catch (...) {
        // A hidden screen would stand in the way of the next one.
        if (Entry::isLoaded() && !Entry::get().isVisible()) Entry::unload();
        throw;
    }
}

bool isEntryUnderWay() {
    // Also while it is hidden: the way out may lead back to it.
    return Entry::isLoaded() && Entry::get().mode() == frmMovimentos::Mode::New;
}

void attachMovement(const ado::RecordsetPtr& rows, QObject* Caller) {
    forms::closeView<frmMovimentos>();
    frmMovimentos& screen = Entry::get();
    screen.attach(rows);
    screen.CallbackClass = Caller;
}

void showMovement(const QString& tipo) {
    Entry::get().showReadOnly(tipo);
    Entry::get().Show();
}

}  // namespace entry
