// SPDX-License-Identifier: MIT
#include "coverage/Posting.h"
#include "coverage/Queries.h"
#include "coverage/stages.h"
#include "data/Codes.h"
#include "data/Correction.h"
#include "data/NewMovement.h"
#include "data/Procedures.h"
#include "data/RowSets.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace coverage {

namespace {

using core::Icon;
using core::MsgBox;
using core::passingOver;

bool entryChecks(const PostingEntry& posting) {
    const auto missing = [&](const QString& text) {
        MsgBox(text, Icon::Information, posting.entry.caption);
        return false;
    };
    if (posting.DataCombo3.isEmpty()) return missing(u"Tem de indicar um modo de pagamento."_s);
    if (posting.Text7.isEmpty()) return missing(u"Tem de introduzir a data do registo."_s);
    if (posting.Text1.isEmpty()) return missing(u"Tem de introduzir a data do documento."_s);
    if (posting.Text5.isEmpty()) return missing(u"Tem de introduzir o número do documento."_s);
    if (posting.entry.bHospital && posting.DataCombo2.isEmpty())
        return missing(u"Tem de indicar um hospital."_s);
    return true;
}

/// Made for every mode of payment, cheques included. A member who has left only warns.
bool bankNumberCheck(qint32 socio_id) {
    const ado::RecordsetPtr member = data::openToRead(statements::member(socio_id));
    if (member->atEnd()) {
        MsgBox(u"Este Associado não se encontra na tabela de Activos."_s, Icon::Critical);
        return true;
    }
    const QVariant nib = member->Collect(u"nib"_s);
    if (core::isNullOrEmpty(nib)) {
        MsgBox(u"Este Associado não tem NIB!"_s, Icon::Critical);
        return false;
    }
    if (nib.toString().size() != data::NibLength) {
        MsgBox(u"Este Associado tem especificado um NIB INVÁLIDO!"_s, Icon::Critical);
        return false;
    }
    return true;
}

/// A failing statement is passed over; false when one failed. A movement without a number is not
/// saved: it would be paid without standing in the accumulators.
bool save(const PostingEntry& posting, data::Operation& operation) {
    ado::Recordset& record = *posting.entry.record;
    passingOver([&] {
        record.setCollect(u"created_by"_s, data::ObterUtilizador());
        data::numberAndSave(record, operation);
    });
    return data::savedOrTold(posting.entry.caption);
}

bool confirmTyped(const Entry& entry, data::Operation& operation) {
    return data::confirmUnusual(
        *entry.record,
        {{u"data"_s, u"A data do registo"_s},
         {u"doc_data"_s, u"A data do documento"_s},
         {u"doc_valor"_s, u"O valor do documento"_s},
         entry.bHospital ? data::Typed{u"incidencia"_s, u"O valor de incidência"_s}
                         : data::Typed{u"recebido"_s, u"O valor recebido"_s}},
        entry.caption, operation);
}

void addToAccumulators(const ado::Recordset& movement, const ado::Accompaniment& with) {
    const QVariant rubrica_id = movement.Collect(u"rubrica_id"_s);
    const qint32 socio_id = core::toLong(movement.Collect(u"socio_id"_s));
    const ado::RecordsetPtr rows = data::openToWrite(
        statements::accumulator(rubrica_id, socio_id, core::toText(movement.Collect(u"codABC"_s)),
                                data::twinsOf(movement).accumulators));
    if (rows->atEnd()) {
        rows->AddNew();
        rows->setCollect(u"Socio_ID"_s, socio_id);
        rows->setCollect(u"Rubrica_ID"_s, rubrica_id);
    }
    data::add(*rows, u"credito_ac"_s, movement.Collect(u"credito"_s));
    data::add(*rows, u"debito_ac"_s, movement.Collect(u"debito"_s));
    data::add(*rows, u"No_Docs"_s, 1);
    rows->Update(with);
    rows->Close();
}

}  // namespace

const data::MovementRules& documentRules() {
    static const data::MovementRules rules{addToAccumulators, setCorrection, takeBack};
    return rules;
}

bool post(const PostingEntry& posting, TryOut& run, data::Operation& operation) {
    const Entry& entry = posting.entry;
    if (data::isRegistered(operation))
        return data::finishPosting(operation, documentRules(), *entry.record, entry.caption);
    if (!data::confirmPosting(entry.caption) || !confirmTyped(entry, operation)) return false;
    tryOut(entry, run);
    // Still true after the boxes of the minimum and of the number of documents: the posting then
    // goes on with what the row holds. It is meant so.
    if (!run.bEnsaioValido) return false;
    if (!entryChecks(posting) || !bankNumberCheck(entry.Socio_ID)) return false;

    entry.record->setCollect(u"socio_id"_s, entry.Socio_ID);
    core::err().clear();
    if (core::toText(posting.modo_pagamento) == data::modo::Cheque) posting.askCheque(entry.record);
    if (!save(posting, operation)) return false;
    return data::accumulatedOrTold(operation, *entry.record, documentRules(), entry.caption);
}

}  // namespace coverage
