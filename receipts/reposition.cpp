// SPDX-License-Identifier: MIT
#include "receipts/reposition.h"

#include "data/NewMovement.h"
#include "data/RowSets.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace receipts {

namespace {

using core::passingOver;

bool repositionChecks(const RepositionEntry& reposition) {
    const auto missing = [&](const QString& text) {
        core::MsgBox(text, core::Icon::Information, reposition.caption);
        return false;
    };
    const auto isZero = [&](const QString& column) {
        return core::compareNumbers(reposition.record->Collect(column), 0) == 0;
    };
    const QString noAmount = u"Tem de indicar um valor para o crédito ou para o débito!"_s;
    if (reposition.DataCombo1.isEmpty() != reposition.Text3.isEmpty())
        return missing(u"Uma rubrica tem de estar associada a um familiar."_s);
    if (reposition.No_Kor.isEmpty()) return missing(u"Tem de indicar um Sócio!"_s);
    if (reposition.Debito.isEmpty() || reposition.Credito.isEmpty()) return missing(noAmount);
    if (isZero(u"debito"_s) && isZero(u"credito"_s)) return missing(noAmount);
    return true;
}

/// Accumulators of member, rubric and person; rubric 0 where none was chosen. The comparison with
/// Null holds for no row, so that every reposition without a rubric adds one. It is meant so.
QString accumulatorStatement(const RepositionEntry& reposition) {
    const QString rubric =
        reposition.DataCombo1.isEmpty()
            ? u" AND (rubrica_id = 0 )"_s
            : u" AND (rubrica_id ="_s + core::toText(reposition.rubrica_id) + u")"_s;
    const QString person = reposition.Text3.isEmpty()
                               ? u"AND (codABC = Null)"_s
                               : u"AND (codABC='"_s + reposition.Text3 + u"')"_s;
    return u"Select * from tbSocios_Acumulados WHERE (socio_id="_s +
           QString::number(reposition.Socio_ID) + u")"_s + rubric + person;
}

void addToAccumulator(const RepositionEntry& reposition) {
    const ado::RecordsetPtr rows = data::openToWrite(accumulatorStatement(reposition));
    if (rows->atEnd()) rows->AddNew();
    const bool hasRubric = !reposition.DataCombo1.isEmpty();
    const bool hasPerson = !reposition.Text3.isEmpty();
    rows->setCollect(u"Socio_ID"_s, reposition.Socio_ID);
    rows->setCollect(u"Rubrica_ID"_s, hasRubric ? reposition.rubrica_id : QVariant(0));
    rows->setCollect(u"codABC"_s, hasPerson ? QVariant(reposition.Text3) : QVariant());
    for (const auto& [sum, amount] :
         {std::pair(u"credito_ac"_s, u"credito"_s), std::pair(u"debito_ac"_s, u"debito"_s)}) {
        data::nullBecomesZero(*rows, sum);
        data::add(*rows, sum, reposition.record->Collect(amount));
    }
    rows->Update();
    rows->Close();
}

}  // namespace

bool postReposition(const RepositionEntry& reposition) {
    if (!data::confirmPosting(reposition.caption) || !repositionChecks(reposition)) return false;
    data::readyWithoutDocument(*reposition.record, reposition.Socio_ID);
    passingOver([&] { data::numberAndSave(*reposition.record); });
    if (!data::savedOrTold(reposition.caption)) return false;
    passingOver([&] { addToAccumulator(reposition); });
    return true;
}

}  // namespace receipts
