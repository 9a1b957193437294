// SPDX-License-Identifier: MIT
#include "data/Premium.h"

#include "data/RowSets.h"
#include "platform/core/Clock.h"
#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace data {

namespace {

/// A comparison with a null does not hold, neither this one.
bool differ(const QVariant& a, const QVariant& b) {
    const std::partial_ordering order = core::compareNumbers(a, b);
    return order != std::partial_ordering::unordered && order != 0;
}

/// One month's delay is tolerated; a year ahead of today is a difference like one behind.
bool inArrears(const ado::Recordset& premium) {
    const QDate today = core::today();
    return differ(today.year(), premium.Collect(u"ult_ano"_s)) ||
           core::compareNumbers(today.month() - 1, premium.Collect(u"ult_mes"_s)) > 0;
}

}  // namespace

QString premiumQuery(qint32 socio_id) {
    return u"select * from tbQuotas_Socios where socio_id="_s + QString::number(socio_id);
}

QString premiumWarning(qint32 socio_id) {
    const ado::RecordsetPtr premium = data::openToRead(premiumQuery(socio_id));
    if (premium->atEnd())
        return u"Este Associado ainda não liquidou nenhum prémio de zelmar (quotizações do Plano "
               "de Saúde)."_s;
    if (inArrears(*premium))
        return u"Este Associado tem em atrazo o prémio de zelmar (quotizações do Plano de Saúde) "
               "desde "_s +
               core::toText(premium->Collect(u"ult_mes"_s)) + u"/"_s +
               core::toText(premium->Collect(u"ult_ano"_s)) + u"."_s;
    if (differ(premium->Collect(u"total_quotas"_s), premium->Collect(u"total_pago"_s)))
        return u"Este Associado o prémio de zelmar (quotizações do Plano de Saúde) por liquidar."_s;
    return {};
}

}  // namespace data
