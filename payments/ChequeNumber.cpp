// SPDX-License-Identifier: MIT
#include "payments/ChequeNumber.h"

#include "boundary/environment/dtZelmars.h"
#include "platform/core/Failure.h"
#include "platform/core/Format.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace payments {

namespace {

/// More digits than any cheque has; one step further still fits.
constexpr qint64 LargestNumber = 999'999'999'999'999;

ado::RecordsetPtr openCheques() {
    const ado::RecordsetPtr rows = ado::Recordset::create();
    rows->Open(ChequesStatement.toString(), environment::dtZelmars::instance().MSAccess(),
               ado::adOpenStatic, ado::adLockPessimistic, ado::adCmdUnknown);
    return rows;
}

}  // namespace

QString nextChequeNumber() {
    const ado::RecordsetPtr rows = openCheques();
    if (rows->atEnd()) {
        rows->AddNew();
        rows->setCollect(u"cheque_no"_s, 0);
        rows->Update();
    }
    const QString number = core::toText(rows->Collect(u"cheque_no"_s));
    rows->Close();
    return number;
}

qint64 chequeNumber(const QString& typed) {
    const std::optional<QString> plain = core::parseDecimal(typed);
    bool ok = false;
    const qint64 number = plain ? plain->toLongLong(&ok) : 0;
    if (!ok || number > LargestNumber || number < -LargestNumber)
        throw core::Failure(core::TypeMismatch,
                            u"«%1» não é um número de cheque válido."_s.arg(typed.left(60)));
    return number;
}

void storeChequeNumber(qint64 used) {
    const ado::RecordsetPtr rows = openCheques();
    if (rows->atEnd()) rows->AddNew();
    rows->setCollect(u"cheque_no"_s, used + 1);
    rows->Update();
    rows->Close();
}

}  // namespace payments
