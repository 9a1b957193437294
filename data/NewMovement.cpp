// SPDX-License-Identifier: MIT
#include "data/NewMovement.h"

#include <cmath>

#include "boundary/environment/dtZelmars.h"
#include "data/Codes.h"
#include "platform/core/Clock.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

ado::RecordsetPtr openNewMovement(QString& strConMember, QString& strSQL) {
    if (strSQL.isEmpty()) strSQL = NoMovementQuery.toString();
    if (strConMember.isEmpty()) strConMember = u"MSAccess"_s;
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(strSQL, environment::dtZelmars::instance().Connections(strConMember),
               ado::adOpenStatic, ado::adLockPessimistic, ado::adCmdUnknown);
    return rows;
}

qint32 drawMovementNumber() {
    qint32 number = 1;
    const ado::RecordsetPtr counter = ado::Recordset::create();
    counter->Open(CounterQuery.toString(), environment::dtZelmars::instance().MSAccess(),
                  ado::adOpenDynamic, ado::adLockPessimistic, ado::adCmdUnknown);
    if (counter->atEnd()) {
        counter->AddNew();
        counter->setCollect(u"zelmars"_s, 1);
    } else {
        number = core::toLong(counter->Collect(u"zelmars"_s));
        counter->setCollect(u"zelmars"_s, static_cast<qint64>(number) + 1);
    }
    counter->Update();
    counter->Close();
    return number;
}

bool confirmPosting(const QString& caption) {
    return core::MsgBox(u"Deseja finalizar o registo?"_s, core::Icon::Question, caption,
                        core::Buttons::YesNo) == core::Answer::Yes;
}

namespace {

constexpr int YearsBack = 5;
constexpr int YearsAhead = 1;
constexpr double LargestUsual = 1'000'000;  // euros

/// What is in doubt, as a question; empty for a usual value.
QString doubtOf(const QVariant& value, const QString& name) {
    if (core::isNull(value)) return {};
    if (value.typeId() == QMetaType::QDateTime) {
        const QDate day = core::toDate(value);
        const QDate today = core::today();
        if (day >= today.addYears(-YearsBack) && day <= today.addYears(YearsAhead)) return {};
        return u"%1 é %2. Está certa?"_s.arg(name, core::formatted(value, core::format::Date));
    }
    if (std::abs(core::toDouble(value)) <= LargestUsual) return {};
    return u"%1 é %2. Está certo?"_s.arg(name, core::formatted(value, core::format::Money));
}

}  // namespace

bool confirmUnusual(const ado::Recordset& movement, std::initializer_list<Typed> values,
                    const QString& caption, Operation& posting) {
    for (const Typed& typed : values) {
        const QString doubt = doubtOf(movement.Collect(typed.column), typed.name);
        if (doubt.isEmpty() || posting.confirmed.contains(doubt)) continue;
        if (core::MsgBox(doubt, core::Icon::Question, caption, core::Buttons::NoYes) !=
            core::Answer::Yes)
            return false;
        posting.confirmed += doubt;
    }
    return true;
}

bool checkDated(const ado::Recordset& movement, const QString& caption) {
    if (!core::isNull(movement.Collect(u"data"_s))) return true;
    core::MsgBox(u"Tem de introduzir a data do registo."_s, core::Icon::Information, caption);
    return false;
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
