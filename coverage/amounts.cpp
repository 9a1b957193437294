// SPDX-License-Identifier: MIT
// The amounts of a movement, from the plan's share, what is left of the ceilings and the franchise.
#include "boundary/environment/dtZelmars.h"
#include "coverage/Queries.h"
#include "coverage/stages.h"

using namespace Qt::StringLiterals;

namespace coverage {

namespace {

/// The first row of a query on the shaping connection, where the sums run.
ado::RecordsetPtr openSums(const QString& query) {
    const ado::RecordsetPtr sums = ado::Recordset::create();
    sums->Open(query, environment::dtZelmars::instance().SqlServer());
    return sums;
}

/// The member's balance before this document: debits less credits. No accumulator is 0; a null sum
/// gives a null balance.
QVariant balance(qint32 socio_id) {
    const ado::RecordsetPtr sums = openSums(queries::balance(socio_id));
    if (sums->atEnd()) return 0;
    const QVariant debit = sums->Collect(u"tdebito_ac"_s);
    const QVariant credit = sums->Collect(u"tcredito_ac"_s);
    if (core::isNull(debit) || core::isNull(credit)) return {};
    return core::toDouble(debit) - core::toDouble(credit);
}

Single gross(const Course& course) {
    const Single share = course.single(u"comparticipacao"_s);
    if (course.document.isHospital) return share;
    return grossAmount(share, core::toDouble(course.value(u"incidencia"_s)),
                       core::toDouble(course.value(u"recebido"_s)));
}

/// How much of the franchise the family has spent on this rubric.
Single spent(const Document& document) {
    const ado::RecordsetPtr sums =
        openSums(queries::franchise(document.socio_id, document.rubrica_id));
    if (sums->atEnd()) return {};
    const QVariant net = sums->Collect(u"t_iliquido"_s);
    const QVariant credit = sums->Collect(u"t_credito"_s);
    if (core::isNull(net) || core::isNull(credit)) return {};
    return spentFranchise(core::toDouble(net), core::toDouble(credit));
}

Single credit(Course& course) {
    const Single net = course.single(u"liquido"_s);
    Explanation& told = course.told;
    if (told.franchise == Single()) return net;
    told.franchiseSpent = spent(course.document);
    return creditAmount(net, told.franchise, told.franchiseSpent);
}

/// What the columns keep, beside how it came about.
void tell(Course& course) {
    Explanation& told = course.told;
    told.gross = course.value(u"iliquido"_s);
    told.net = course.value(u"liquido"_s);
    told.credit = course.value(u"credito"_s);
    told.debit = course.value(u"debito"_s);
    told.end = Explanation::End::Reached;
}

}  // namespace

void setAmounts(Course& course) {
    const bool isHospital = course.document.isHospital;
    if (isHospital)
        course.progress.advance();
    else
        course.reach(Result::SaldoCC, u"saldo_acumulado"_s, balance(course.document.socio_id));
    course.reach(Result::Iliquido, u"iliquido"_s, gross(course));
    course.reach(Result::Liquido, u"liquido"_s,
                 netAmount(course.single(u"iliquido"_s), course.single(u"saldo_plafond"_s)));
    course.reach(Result::Credito, u"credito"_s, credit(course));
    if (isHospital) {
        course.keep(u"debito"_s, course.single(u"doc_valor"_s));
        // Intentional: the value itself, and not what the column keeps of its 32-bit float.
        course.reach(Result::Debito, course.value(u"doc_valor"_s));
    } else {
        course.reach(Result::Debito, u"debito"_s, debitAmount(course.single(u"credito"_s)));
    }
    tell(course);
    course.progress.finish();
}

}  // namespace coverage
