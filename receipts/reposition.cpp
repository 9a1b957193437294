// SPDX-License-Identifier: MIT
#include "receipts/reposition.h"

#include "data/Annulment.h"
#include "data/NewMovement.h"
#include "data/RowSets.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace receipts {

namespace {

using core::passingOver;

bool repositionChecks(const Reposition& reposition) {
    const auto missing = [&](const QString& text) {
        core::MsgBox(text, core::Icon::Information, reposition.caption);
        return false;
    };
    const auto isZero = [&](const QString& column) {
        return core::compareNumbers(reposition.record->Collect(column), 0) == 0;
    };
    const QString noAmount = u"Tem de indicar um valor para o crédito ou para o débito!"_s;
    if (reposition.rubric.isEmpty() != reposition.personCode.isEmpty())
        return missing(u"Uma rubrica tem de estar associada a um familiar."_s);
    if (reposition.memberNumber.isEmpty()) return missing(u"Tem de indicar um Sócio!"_s);
    if (reposition.debit.isEmpty() || reposition.credit.isEmpty()) return missing(noAmount);
    if (isZero(u"debito"_s) && isZero(u"credito"_s)) return missing(noAmount);
    return data::checkDated(*reposition.record, reposition.caption);
}

void addToAccumulator(const ado::Recordset& movement, const ado::Accompaniment& with) {
    const qint32 socio_id = core::toLong(movement.Collect(u"socio_id"_s));
    const QString codABC = core::toText(movement.Collect(u"codABC"_s));
    QVariant rubrica_id = movement.Collect(u"rubrica_id"_s);
    // A rubric that was wiped is held as 0.
    if (core::compareNumbers(rubrica_id, 0) == 0) rubrica_id = {};
    const ado::RecordsetPtr rows = data::openToWrite(
        accumulatorQuery(data::twinsOf(movement).accumulators, socio_id, rubrica_id, codABC));
    if (rows->atEnd()) rows->AddNew();
    rows->setCollect(u"Socio_ID"_s, socio_id);
    rows->setCollect(u"Rubrica_ID"_s, core::isNull(rubrica_id) ? QVariant(0) : rubrica_id);
    rows->setCollect(u"codABC"_s, codABC.isEmpty() ? QVariant() : QVariant(codABC));
    for (const auto& [sum, amount] :
         {std::pair(u"credito_ac"_s, u"credito"_s), std::pair(u"debito_ac"_s, u"debito"_s)}) {
        data::nullBecomesZero(*rows, sum);
        data::add(*rows, sum, movement.Collect(amount));
    }
    rows->Update(with);
    rows->Close();
}

}  // namespace

QString accumulatorQuery(const QString& table, qint32 socio_id, const QVariant& rubrica_id,
                         const QString& codABC) {
    const QString rubric = core::isNull(rubrica_id)
                               ? u" AND (rubrica_id = 0 )"_s
                               : u" AND (rubrica_id ="_s + core::toText(rubrica_id) + u")"_s;
    const QString person =
        codABC.isEmpty() ? u"AND (codABC = Null)"_s : u"AND (codABC='"_s + codABC + u"')"_s;
    return u"Select * from "_s + table + u" WHERE (socio_id="_s + QString::number(socio_id) +
           u")"_s + rubric + person;
}

const data::MovementRules& repositionRules() {
    static const data::MovementRules rules{addToAccumulator};
    return rules;
}

bool postReposition(const Reposition& reposition, data::Operation& operation) {
    const QString& caption = reposition.caption;
    if (data::isRegistered(operation))
        return data::finishPosting(operation, repositionRules(), *reposition.record, caption);
    if (!data::confirmPosting(caption) || !repositionChecks(reposition)) return false;
    if (!data::confirmUnusual(*reposition.record,
                              {{u"data"_s, u"A data do registo"_s},
                               {u"debito"_s, u"O valor do débito"_s},
                               {u"credito"_s, u"O valor do crédito"_s}},
                              caption, operation))
        return false;
    data::readyWithoutDocument(*reposition.record, reposition.socio_id);
    passingOver([&] { data::numberAndSave(*reposition.record, operation); });
    if (!data::savedOrTold(caption)) return false;
    return data::accumulatedOrTold(operation, *reposition.record, repositionRules(), caption);
}

}  // namespace receipts
