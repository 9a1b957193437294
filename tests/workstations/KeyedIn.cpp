// SPDX-License-Identifier: MIT
#include "tests/workstations/KeyedIn.h"

#include "boundary/environment/dtZelmars.h"
#include "payments/ChequeNumber.h"
#include "platform/core/Clock.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace office {

namespace {

/// The pending row as the entry screen opens and fills it.
ado::RecordsetPtr keyIn(const Job& job, const QString& number) {
    const ado::RecordsetPtr row = ado::Recordset::create();
    row->Open(u"select * from tbzelmar_movimentos where movimento_id = 0"_s,
              environment::dtZelmars::instance().MSAccess(), ado::adOpenStatic,
              ado::adLockPessimistic, ado::adCmdUnknown);
    row->AddNew();
    const QVariant today = core::fromDate(core::today());
    const QString value = QString::number(static_cast<double>(job.cents) / 100, 'f', 2);
    const std::pair<QString, QVariant> columns[] = {
        {u"data"_s, today},
        {u"tipo"_s, job.isBill ? u"HOS"_s : u"DOC"_s},
        {u"codABC"_s, job.codABC},
        {u"rubrica_id"_s, job.rubrica_id},
        {u"doc_data"_s, today},
        {u"doc_no"_s, number},
        {u"doc_valor"_s, value},
        {job.isBill ? u"incidencia"_s : u"recebido"_s, job.isBill ? value : u"0"_s},
        {u"modo_pagamento"_s, job.isBill ? u"CHQ"_s : u"TRF"_s},
    };
    for (const auto& [column, content] : columns) row->setCollect(column, content);
    return row;
}

/// The cheque's number that the screen would offer.
void takeCheque(const ado::RecordsetPtr& movement) {
    const qint64 number = payments::chequeNumber(payments::nextChequeNumber());
    movement->setCollect(u"cheque"_s, number);
    payments::storeChequeNumber(number);
}

}  // namespace

coverage::Posting keyedIn(const Job& job, const QString& number) {
    const QString typed = u"1"_s;  // what is only looked at for being there
    return {.document = {.record = keyIn(job, number),
                         .socio_id = job.socio_id,
                         .isHospital = job.isBill,
                         .caption = u"Lançamento (Plano de Saúde)"_s,
                         .personCode = job.codABC,
                         .documentValue = typed,
                         .receivedOrIncidence = typed,
                         .rubric = typed,
                         .rubrica_id = job.rubrica_id},
            .paymentMode = typed,
            .modo_pagamento = job.isBill ? u"CHQ"_s : u"TRF"_s,
            .movementDate = typed,
            .documentDate = typed,
            .documentNumber = typed,
            .hospital = typed,
            .askCheque = takeCheque};
}

}  // namespace office
