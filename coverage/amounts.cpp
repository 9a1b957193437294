// SPDX-License-Identifier: MIT
// The amounts of a movement, from the plan's share, what is left of the ceilings and the franchise.
#include "boundary/environment/dtZelmars.h"
#include "coverage/Queries.h"
#include "coverage/stages.h"
#include "data/Procedures.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace coverage {

namespace {

/// The first row of a statement on the shaping connection, where the sums run.
ado::RecordsetPtr openSums(const QString& statement) {
    const ado::RecordsetPtr sums = ado::Recordset::create();
    sums->Open(statement, environment::dtZelmars::instance().SqlServer());
    return sums;
}

float single(const Entry& entry, const QString& column) {
    return core::toSingle(entry.record->Collect(column));
}

/// Writes a column and gives back what it keeps.
QVariant write(const Entry& entry, const QString& column, const QVariant& value) {
    entry.record->setCollect(column, value);
    return entry.record->Collect(column);
}

/// The member's balance before this document: debits less credits. No accumulator is 0; a null sum
/// gives a null balance.
QVariant balance(const Entry& entry) {
    const ado::RecordsetPtr sums = openSums(statements::balance(entry.Socio_ID));
    if (sums->atEnd()) return 0;
    const QVariant debit = sums->Collect(u"tdebito_ac"_s);
    const QVariant credit = sums->Collect(u"tcredito_ac"_s);
    if (core::isNull(debit) || core::isNull(credit)) return {};
    return core::toDouble(debit) - core::toDouble(credit);
}

float gross(const Entry& entry) {
    const float share = single(entry, u"comparticipacao"_s);
    if (entry.bHospital) return share;
    const double left = core::toDouble(entry.record->Collect(u"incidencia"_s)) -
                        core::toDouble(entry.record->Collect(u"recebido"_s));
    return data::MinSingle(share, core::toSingle(left));
}

/// How much of the franchise the family has spent on this rubric. Can be negative.
float spentFranchise(const Entry& entry) {
    const ado::RecordsetPtr sums =
        openSums(statements::franchise(entry.Socio_ID, entry.rubrica_id));
    if (sums->atEnd()) return 0.0F;
    const QVariant net = sums->Collect(u"t_iliquido"_s);
    const QVariant credit = sums->Collect(u"t_credito"_s);
    if (core::isNull(net) || core::isNull(credit)) return 0.0F;
    return core::toSingle(core::toDouble(net) - core::toDouble(credit));
}

/// The net amount less what is left of the franchise, never below 0 by the franchise.
float creditAfterFranchise(const Entry& entry, float franquia) {
    const float net = single(entry, u"liquido"_s);
    if (franquia == 0.0F) return net;
    const float consumido = spentFranchise(entry);
    if (!(consumido < franquia)) return net;
    const float resto =
        core::toSingle(static_cast<double>(franquia) - static_cast<double>(consumido));
    return resto < net ? net - resto : 0.0F;
}

}  // namespace

void setAmounts(const Entry& entry, const Working& working, Progress& progress, TryOut& run) {
    if (!entry.bHospital)
        run.show(&Results::SaldoCC, write(entry, u"saldo_acumulado"_s, balance(entry)));
    progress.advance();

    run.show(&Results::Iliquido, write(entry, u"iliquido"_s, gross(entry)));
    progress.advance();

    const float net =
        data::MinSingle(single(entry, u"iliquido"_s), single(entry, u"saldo_plafond"_s));
    run.show(&Results::Liquido, write(entry, u"liquido"_s, net));
    progress.advance();

    run.show(&Results::Credito,
             write(entry, u"credito"_s, creditAfterFranchise(entry, working.franquia)));
    progress.advance();

    if (entry.bHospital) {
        write(entry, u"debito"_s, single(entry, u"doc_valor"_s));
        run.show(&Results::Debito, entry.record->Collect(u"doc_valor"_s));
    } else {
        run.show(&Results::Debito,
                 write(entry, u"debito"_s, data::MaxSingle(0.0F, single(entry, u"credito"_s))));
    }
    progress.advance();
    progress.finish();
}

}  // namespace coverage
