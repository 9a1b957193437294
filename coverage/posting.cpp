// SPDX-License-Identifier: MIT
#include "coverage/Posting.h"
#include "coverage/Queries.h"
#include "coverage/stages.h"
#include "data/Annulment.h"
#include "data/Codes.h"
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

bool isComplete(const Posting& posting) {
    const auto missing = [&](const QString& text) {
        MsgBox(text, Icon::Information, posting.document.caption);
        return false;
    };
    if (posting.paymentMode.isEmpty()) return missing(u"Tem de indicar um modo de pagamento."_s);
    if (posting.movementDate.isEmpty()) return missing(u"Tem de introduzir a data do registo."_s);
    if (posting.documentDate.isEmpty()) return missing(u"Tem de introduzir a data do documento."_s);
    if (posting.documentNumber.isEmpty())
        return missing(u"Tem de introduzir o número do documento."_s);
    if (posting.document.isHospital && posting.hospital.isEmpty())
        return missing(u"Tem de indicar um hospital."_s);
    return true;
}

/// Made for every mode of payment, cheques included. A member who has left only warns.
bool bankNumberCheck(qint32 socio_id) {
    const ado::RecordsetPtr member = data::openToRead(queries::member(socio_id));
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

/// A step that fails is passed over; false when one failed. A movement without a number is not
/// saved: it would be paid without standing in the accumulators.
bool save(const Posting& posting, data::Operation& operation) {
    ado::Recordset& record = *posting.document.record;
    passingOver([&] {
        record.setCollect(u"created_by"_s, data::ObterUtilizador());
        data::numberAndSave(record, operation);
    });
    return data::savedOrTold(posting.document.caption);
}

bool confirmTyped(const Document& document, data::Operation& operation) {
    return data::confirmUnusual(
        *document.record,
        {{u"data"_s, u"A data do registo"_s},
         {u"doc_data"_s, u"A data do documento"_s},
         {u"doc_valor"_s, u"O valor do documento"_s},
         document.isHospital ? data::Typed{u"incidencia"_s, u"O valor de incidência"_s}
                             : data::Typed{u"recebido"_s, u"O valor recebido"_s}},
        document.caption, operation);
}

void addToAccumulators(const ado::Recordset& movement, const ado::Accompaniment& with) {
    const QVariant rubrica_id = movement.Collect(u"rubrica_id"_s);
    const qint32 socio_id = core::toLong(movement.Collect(u"socio_id"_s));
    const ado::RecordsetPtr rows = data::openToWrite(
        queries::accumulator(rubrica_id, socio_id, core::toText(movement.Collect(u"codABC"_s)),
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
    static const data::MovementRules rules{addToAccumulators, setCorrectingRow, takeBack};
    return rules;
}

bool post(const Posting& posting, TryOut& run, data::Operation& operation) {
    const Document& document = posting.document;
    if (data::isRegistered(operation))
        return data::finishPosting(operation, documentRules(), *document.record, document.caption);
    if (!data::confirmPosting(document.caption) || !confirmTyped(document, operation)) return false;
    tryOut(document, run);
    if (!run.bEnsaioValido) return false;
    if (!isComplete(posting) || !bankNumberCheck(document.socio_id)) return false;

    document.record->setCollect(u"socio_id"_s, document.socio_id);
    core::err().clear();
    if (core::toText(posting.modo_pagamento) == data::modo::Cheque)
        posting.askCheque(document.record);
    if (!save(posting, operation)) return false;
    return data::accumulatedOrTold(operation, *document.record, documentRules(), document.caption);
}

}  // namespace coverage
