// SPDX-License-Identifier: MIT
// What undoes a document: the mark on its row, a row with the amounts negated beside it, and the
// accumulators taken back, in the tables in which the member lives now.
#include "coverage/annulment.h"

#include "coverage/Posting.h"
#include "coverage/Queries.h"
#include "coverage/stages.h"
#include "data/Annulment.h"
#include "data/RowSets.h"
#include "platform/com/Component.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace coverage {

namespace {

/// An amount of the movement shown, in single precision; a null is left out.
void take(const ado::Recordset& shown, ado::Recordset& correcting, const QString& column,
          bool isNegated) {
    const QVariant amount = shown.Collect(column);
    if (core::isNull(amount)) return;
    const Single single(amount);
    correcting.setCollect(column, isNegated ? -single : single);
}

}  // namespace

/// Intentional: neither `liquido` nor `created_by` nor a mode is set, so that an annulled document
/// raises the franchise already used.
void setCorrectingRow(const ado::Recordset& shown, ado::Recordset& correcting) {
    for (const QString& column : {u"codABC"_s, u"rubrica_id"_s, u"doc_no"_s, u"doc_data"_s})
        correcting.setCollect(column, shown.Collect(column));
    take(shown, correcting, u"doc_valor"_s, false);
    take(shown, correcting, u"credito"_s, true);
    take(shown, correcting, u"debito"_s, true);
    const QVariant hospital_id = shown.Collect(u"hospital_id"_s);
    if (!core::isNull(hospital_id)) correcting.setCollect(u"hospital_id"_s, hospital_id);
}

/// The first row found; a missing one fails.
void takeBack(const ado::Recordset& shown, const ado::Accompaniment& with) {
    const ado::RecordsetPtr rows = data::openToWrite(queries::accumulator(
        shown.Collect(u"rubrica_id"_s), core::toLong(shown.Collect(u"socio_id"_s)),
        core::toText(shown.Collect(u"codABC"_s)), data::twinsOf(shown).accumulators));
    data::subtract(*rows, u"credito_ac"_s, shown.Collect(u"credito"_s));
    data::subtract(*rows, u"debito_ac"_s, shown.Collect(u"debito"_s));
    data::subtract(*rows, u"No_Docs"_s, 1);
    rows->Update(with);
    rows->Close();
}

bool annul(const Annulment& annulment, data::Operation& operation) {
    const ado::Recordset& shown = *annulment.shown;
    if (!data::isRegistered(operation) && !data::confirmAnnulment(u"Anular Lançamento"_s))
        return false;
    const data::Annulled outcome =
        data::annul(shown, annulment.caption, documentRules(), operation);
    if (outcome == data::Annulled::Unfinished) return false;
    if (outcome == data::Annulled::Corrected) {
        // Failures above do not get here: only what an earlier procedure left pending is found,
        // and then the accumulators are left alone.
        if (core::err().number() != 0)
            core::MsgBox(u"Erro não especificado, contacte o Administrador do Sistema. "_s +
                             core::err().description(),
                         core::Icon::Critical, annulment.caption);
        else if (!data::accumulatedOrTold(operation, shown, documentRules(), annulment.caption))
            return false;
    }
    if (annulment.CallbackClass)
        core::passingOver([&] {
            com::call(annulment.CallbackClass, u"RemoteKey"_s, {shown.Collect(u"movimento_id"_s)});
        });
    return true;
}

}  // namespace coverage
