// SPDX-License-Identifier: MIT
#include "data/NewMovement.h"

#include "boundary/environment/dtZelmars.h"
#include "data/MovementNumber.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"

using namespace Qt::StringLiterals;

namespace data {

ado::RecordsetPtr openNewMovement(QString& strConMember, QString& strSQL) {
    if (strSQL.isEmpty()) strSQL = u"select * from tbzelmar_movimentos where movimento_id = 0"_s;
    if (strConMember.isEmpty()) strConMember = u"MSAccess"_s;
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(strSQL, environment::dtZelmars::instance().Connections(strConMember),
               ado::adOpenStatic, ado::adLockPessimistic, ado::adCmdUnknown);
    return rows;
}

bool confirmPosting(const QString& caption) {
    return core::MsgBox(u"Deseja finalizar o registo?"_s, core::Icon::Question, caption,
                        core::Buttons::YesNo) == core::Answer::Yes;
}

void readyWithoutDocument(ado::Recordset& movement, qint32 socio_id) {
    movement.setCollect(u"doc_valor"_s, 0);
    movement.setCollect(u"socio_id"_s, socio_id);
    core::err().clear();
}

void numberAndSave(ado::Recordset& movement) {
    movement.setCollect(u"movimento_no"_s, drawMovementNumber());
    movement.Update();
}

bool savedOrTold(const QString& caption) {
    if (core::err().number() == 0) return true;
    core::MsgBox(core::err().description());
    core::MsgBox(u"Não foi possível registar o registo, contacte o Administrador do Sistema."_s,
                 core::Icon::Critical, caption);
    return false;
}

}  // namespace data
