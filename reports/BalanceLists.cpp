// SPDX-License-Identifier: MIT
#include "reports/BalanceLists.h"

#include "platform/core/Format.h"
#include "reports/Furniture.h"

using namespace Qt::StringLiterals;

namespace reports {

using namespace printing;

namespace {

/// @param condition  what holds of the balance, which stands in it as %1
QString balancesQuery(const QString& condition) {
    const QString balance = u"round(Sum(coalesce(debito, 0) - coalesce(credito, 0)), 4)"_s;
    const auto of = [&](const QString& movements, const QString& members) {
        return u"SELECT %2.no_kor, %2.nome, %3 AS saldo FROM %1 LEFT OUTER JOIN %2 ON %1.socio_id "
               u"= "
               "%2.socio_id GROUP BY %1.socio_id, %2.no_kor, %2.nome HAVING %4"_s.arg(
                   movements, members, balance, condition.arg(balance));
    };
    return of(u"tbZelmar_Movimentos"_s, u"tbSocios"_s) + u" UNION ALL "_s +
           of(u"tbZelmar_Movimentos_Inactivos"_s, u"tbSocios_Inactivos"_s) + u" ORDER BY no_kor"_s;
}

}  // namespace

QString carriedDebtsQuery() {
    return balancesQuery(u"%1 > 0.1"_s);
}

QString vanishingBalancesQuery() {
    return balancesQuery(u"%1 <= 0.1 AND %1 <> 0"_s);
}

Report balanceList(const QString& caption) {
    const std::vector<Column> columns{
        {u"Nº Empresa"_s, u"no_kor"_s, 30},
        {u"Nome"_s, u"nome"_s, 116, Align::Left, {}, true},
        {u"Saldo"_s, u"saldo"_s, 40, Align::Right, core::format::Money},
    };
    Report report{.name = u"prtSaldos"_s,
                  .caption = caption,
                  .reportHeader = {.name = u"Section4"_s},
                  .pageHeader = {.name = u"Section2"_s},
                  .detail = {.name = u"Section1"_s},
                  .pageFooter = pageFooter(),
                  .reportFooter = {.name = u"Section5"_s, .height = 2}};
    addLetterhead(report.reportHeader, caption);
    addTitles(report.pageHeader, columns);
    report.detail.height = 0.3;
    addValues(report.detail, columns);
    report.detail.height += 0.3;
    addTotal(report.reportFooter, Total::Of::Count, u"Associados:"_s, u"no_kor"_s, {});
    addTotal(report.reportFooter, Total::Of::Sum, u"Total:"_s, u"saldo"_s, core::format::Money);
    return report;
}

}  // namespace reports
