// SPDX-License-Identifier: MIT
#include "host/Finishing.h"

#include "coverage/Posting.h"
#include "data/Annulment.h"
#include "data/Codes.h"
#include "platform/core/Failure.h"
#include "receipts/receipt.h"
#include "receipts/reposition.h"

using namespace Qt::StringLiterals;

namespace host {

namespace {

const data::MovementRules& rulesOf(const QString& type) {
    if (type == data::tipo::Receipt) return receipts::receiptRules();
    if (type == data::tipo::Reposition) return receipts::repositionRules();
    return coverage::documentRules();
}

void finishSteps(const ado::Recordset& movement, data::Operation& operation) {
    const data::MovementRules& rules = rulesOf(operation.tipo);
    if (operation.missing == data::Step::CorrectingRow)
        data::addCorrectingRow(movement, rules, operation);
    const auto write =
        operation.kind == data::Operation::Kind::Posting ? rules.accumulate : rules.takeBack;
    write(movement, data::journal::finishedLater(operation));
}

}  // namespace

QString finish(data::Operation operation) {
    const QString what = data::named(operation);
    const ado::RecordsetPtr movement = data::openMovement(operation);
    if (!movement) {
        data::journal::close(operation);
        return what + u": o movimento já não está nas contas do ano; não há nada a acrescentar."_s;
    }
    try {
        finishSteps(*movement, operation);
    } catch (const core::Failure& failure) {
        if (failure.number() != core::NotAccompanied) throw;
        return what + u": outro posto já tinha feito o que faltava."_s;
    }
    return what + u": concluído."_s;
}

}  // namespace host
