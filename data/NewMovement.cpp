// SPDX-License-Identifier: MIT
#include "data/NewMovement.h"

#include "boundary/environment/dtZelmars.h"
#include "data/Codes.h"
#include "data/MovementNumber.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

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

void numberAndSave(ado::Recordset& movement, Operation& posting) {
    begin(posting, Operation::Kind::Posting);
    posting.ficheiro = ficheiro::Active.toString();
    posting.socio_id = core::toLong(movement.Collect(u"socio_id"_s));
    posting.tipo = core::toText(movement.Collect(u"tipo"_s));
    posting.movimento_no = drawMovementNumber();
    movement.setCollect(u"movimento_no"_s, posting.movimento_no);
    posting.missing = Step::Accumulator;
    movement.Update(journal::begun(posting, u"movimento_id"_s));
    posting.isRegistered = true;
}

bool finishPosting(Operation& posting, const MovementRules& rules, ado::Recordset& record,
                   const QString& caption) {
    if (posting.missing == Step::Nothing) return true;
    if (!record.isNewRow()) {
        record.CancelUpdate();
        return accumulatedOrTold(posting, record, rules, caption);
    }
    // The row was stored, but its answer was lost.
    const ado::RecordsetPtr movement = openMovement(posting);
    if (movement) return accumulatedOrTold(posting, *movement, rules, caption);
    tellUnfinished(posting, u"O movimento já não está nas contas do ano."_s, caption);
    return false;
}

bool savedOrTold(const QString& caption) {
    if (core::err().number() == 0) return true;
    core::MsgBox(core::err().description());
    core::MsgBox(u"Não foi possível registar o registo, contacte o Administrador do Sistema."_s,
                 core::Icon::Critical, caption);
    return false;
}

}  // namespace data
