// SPDX-License-Identifier: MIT
#include "receipts/receipt.h"

#include "data/Annulment.h"
#include "data/NewMovement.h"
#include "data/RowSets.h"
#include "platform/core/Failure.h"
#include "platform/core/MsgBox.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace receipts {

namespace {

using core::Icon;
using core::MsgBox;

bool receiptChecks(const Receipt& receipt) {
    const auto missing = [&](const QString& text) {
        MsgBox(text, Icon::Information, receipt.caption);
        return false;
    };
    if (receipt.paymentMode.isEmpty()) return missing(u"Tem de indicar um modo de pagamento!"_s);
    if (receipt.memberNumber.isEmpty()) return missing(u"Tem de indicar um Sócio!"_s);
    if (receipt.credit.isEmpty()) return missing(u"Tem de indicar um valor para o crédito!"_s);
    // Intentional: below 0 is let through, and lowers the account.
    if (core::compareNumbers(receipt.record->Collect(u"credito"_s), 0) == 0)
        return missing(u"Tem de indicar um valor diferente de 0(zero) para o crédito !"_s);
    return data::checkDated(*receipt.record, receipt.caption);
}

/// The account-level row alone, and there the credit alone.
void addToAccount(const ado::Recordset& movement, const ado::Accompaniment& with) {
    const qint32 socio_id = core::toLong(movement.Collect(u"socio_id"_s));
    const ado::RecordsetPtr rows =
        data::openToWrite(accountQuery(data::twinsOf(movement).accumulators, socio_id));
    if (rows->atEnd()) {
        rows->AddNew();
        rows->setCollect(u"rubrica_id_main"_s, 0);
    }
    rows->setCollect(u"Socio_ID"_s, socio_id);
    data::nullBecomesZero(*rows, u"credito_ac"_s);
    data::nullBecomesZero(*rows, u"debito_ac"_s);
    data::add(*rows, u"credito_ac"_s, movement.Collect(u"credito"_s));
    rows->Update(with);
    rows->Close();
}

void setCorrectingRow(const ado::Recordset& shown, ado::Recordset& correcting) {
    const QVariant credito = shown.Collect(u"credito"_s);
    if (!core::isNull(credito)) correcting.setCollect(u"credito"_s, -core::toDouble(credito));
    correcting.setCollect(u"debito"_s, 0);
}

/// Intentional: not the account-level row that the posting added to, but the first of the member's
/// rows, whichever it is; and a row that has to be added is nobody's and keeps null sums.
void takeBack(const ado::Recordset& shown, const ado::Accompaniment& with) {
    const ado::RecordsetPtr rows = data::openToWrite(
        accumulatorsQuery(data::twinsOf(shown).accumulators, shown.Collect(u"socio_id"_s)));
    if (rows->atEnd()) rows->AddNew();
    data::subtract(*rows, u"credito_ac"_s, shown.Collect(u"credito"_s));
    data::subtract(*rows, u"debito_ac"_s, shown.Collect(u"debito"_s));
    rows->Update(with);
    rows->Close();
}

}  // namespace

QString accountQuery(const QString& table, qint32 socio_id) {
    return u"Select * from "_s + table + u" WHERE (socio_id="_s + QString::number(socio_id) +
           u") and (rubrica_id_main=0)"_s;
}

QString accumulatorsQuery(const QString& table, const QVariant& socio_id) {
    return u"Select * from "_s + table + u" WHERE (socio_id="_s + core::toText(socio_id) + u")"_s;
}

const data::MovementRules& receiptRules() {
    static const data::MovementRules rules{addToAccount, setCorrectingRow, takeBack};
    return rules;
}

bool postReceipt(const Receipt& receipt, data::Operation& operation) {
    if (data::isRegistered(operation))
        return data::finishPosting(operation, receiptRules(), *receipt.record, receipt.caption);
    if (!data::confirmPosting(receipt.caption) || !receiptChecks(receipt)) return false;
    if (!data::confirmUnusual(
            *receipt.record,
            {{u"data"_s, u"A data do registo"_s}, {u"credito"_s, u"O valor a creditar"_s}},
            receipt.caption, operation))
        return false;
    receipt.record->setCollect(u"debito"_s, 0);
    data::readyWithoutDocument(*receipt.record, receipt.socio_id);
    // Not passed over, unlike on the other screens: a failure goes up with the engine's text.
    data::numberAndSave(*receipt.record, operation);
    if (!data::savedOrTold(receipt.caption)) return false;
    return data::accumulatedOrTold(operation, *receipt.record, receiptRules(), receipt.caption);
}

bool annulReceipt(const ado::RecordsetPtr& shown, const QString& caption,
                  data::Operation& operation) {
    if (!data::isRegistered(operation) && !data::confirmAnnulment(u"Anular Recebimento"_s))
        return false;
    switch (data::annul(*shown, caption, receiptRules(), operation)) {
        case data::Annulled::Unfinished:
            return false;
        case data::Annulled::Elsewhere:
            return true;
        case data::Annulled::Corrected:
            break;
    }
    // Finds only what an earlier procedure left pending; the accumulators are then left alone.
    if (core::err().number() == 0)
        return data::accumulatedOrTold(operation, *shown, receiptRules(), caption);
    MsgBox(u"Erro inesperado, contacte o Administrador do Sistema"_s, Icon::Critical, caption);
    return true;
}

}  // namespace receipts
