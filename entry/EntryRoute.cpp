// SPDX-License-Identifier: MIT
#include "entry/EntryRoute.h"

#include "boundary/environment/dtZelmars.h"
#include "data/Codes.h"
#include "entry/frmMovimentos.h"
#include "entry/frmMovimentosF.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace entry {

namespace {

using Entry = forms::DefaultInstance<frmMovimentos>;
using Exit = forms::DefaultInstance<frmMovimentosF>;
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

void continueWithNewMember() {
    const bool bHospital = Entry::get().bHospital;
    closeEntry();
    openAnother(bHospital);
}

void follow(Choice choice) {
    switch (choice) {
        case Choice::SameMember:
            continueWithSameMember();
            break;
        case Choice::NewMember:
            continueWithNewMember();
            break;
        case Choice::Statements:
            core::MsgBox(u"Os extratos ainda não estão disponíveis nesta versão."_s,
                         core::Icon::Information);
            break;
        case Choice::Leave:
            closeEntry();
            break;
    }
}

/// A read-only view holds nothing that a person typed: it makes room.
void closeView() {
    if (Entry::isLoaded() && Entry::get().bShowing) Entry::unload();
}

/// After an entry was posted or given up.
void askHowToGoOn() {
    Exit::get().onChosen = follow;
    Exit::get().ShowModal();
}

/// The row set of a new entry; empty texts get their defaults.
ado::RecordsetPtr openNewRow(QString& strConMember, QString& strSQL) {
    if (strSQL.isEmpty()) strSQL = u"select * from tbzelmar_movimentos where movimento_id = 0"_s;
    if (strConMember.isEmpty()) strConMember = u"MSAccess"_s;
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(strSQL, environment::dtZelmars::instance().Connections(strConMember),
               ado::adOpenStatic, ado::adLockPessimistic, ado::adCmdUnknown);
    return rows;
}

void showEntry(bool bHospital, const ado::RecordsetPtr& rows) {
    // The form of a hospital entry does not turn back into an ordinary one.
    if (Entry::isLoaded() && Entry::get().bHospital && !bHospital) Entry::unload();
    frmMovimentos& screen = Entry::get();
    screen.bHospital = bHospital;
    if (bHospital) screen.showAsHospital();
    screen.Adodc1->setRecordset(rows);
    rows->AddNew();
    screen.bShowing = false;
    screen.onLeft = askHowToGoOn;
    screen.startDefaults();
    screen.Show();
}

}  // namespace

void openNewMovimento(bool bHospital, QString& strConMember, QString& strSQL) {
    try {
        const ado::RecordsetPtr rows = openNewRow(strConMember, strSQL);
        closeView();
        showEntry(bHospital, rows);
    } catch (...) {
        // A hidden screen would stand in the way of the next one.
        if (Entry::isLoaded() && !Entry::get().isVisible()) Entry::unload();
        throw;
    }
}

void openRegisto(const QVariant& Pkey, QObject* Caller) {
    // A key that is no number fails here; as a number it is not used.
    core::toLong(Pkey);
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(
        u"SELECT * FROM vwZelmars_Movimentos_Vigor WHERE movimento_id = "_s + core::toText(Pkey),
        environment::dtZelmars::instance().MSAccess(), ado::adOpenDynamic, ado::adLockOptimistic,
        ado::adCmdUnknown);
    if (rows->atEnd()) return;
    const QString tipo = core::toText(rows->Collect(u"tipo"_s));
    if (tipo == data::tipo::Receipt || tipo == data::tipo::Reposition)
        throw core::Failure(core::InvalidCall,
                            u"A vista de recebimentos e reposições ainda não está disponível "
                            "nesta versão."_s);
    if (tipo != data::tipo::Document && tipo != data::tipo::Hospital) return;
    closeView();
    if (Entry::isLoaded())
        throw core::Failure(core::InvalidCall,
                            u"Há um lançamento por terminar. Termine-o ou cancele-o antes de ver "
                            "outro movimento."_s);
    frmMovimentos& screen = Entry::get();
    screen.Adodc1->setRecordset(rows);
    screen.CallbackClass = Caller;
    screen.Movimento_ID = rows->Collect(u"movimento_id"_s);
    screen.showReadOnly(tipo);
    screen.Show();
}

}  // namespace entry
