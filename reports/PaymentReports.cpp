// SPDX-License-Identifier: MIT
#include "reports/PaymentReports.h"

#include "platform/core/Format.h"
#include "reports/Furniture.h"

using namespace Qt::StringLiterals;

namespace reports {

using namespace printing;

namespace {

/// @param paidBy   the column that says how: the number of the cheque, or the bank number
/// @param summed   the column of the amounts
Report paymentList(const QString& name, const QString& title, Column paidBy,
                   const QString& summed) {
    paidBy.width = 52;
    // Intentional: both lists call the amounts "Crédito" and their sum "Total de Débitos:", though
    // each of them is only one of the two.
    const std::vector<Column> columns{
        {u"Nº KOR"_s, u"no_kor"_s, 26},
        {u"Nome de Guerra"_s, u"nome_guerra"_s, 72, Align::Left, {}, true},
        paidBy,
        {u"Crédito"_s, summed, 36, Align::Right, core::format::Money},
    };
    Report report{.name = name,
                  .caption = title,
                  .dataMember = name,
                  .reportHeader = {.name = u"Section4"_s},
                  .pageHeader = {.name = u"Section2"_s},
                  .detail = {.name = u"Section1"_s},
                  .pageFooter = datedPageFooter(),
                  .reportFooter = {.name = u"Section5"_s, .height = 2}};
    addTitle(report.reportHeader, title);
    report.reportHeader.height += 3;
    addTitles(report.pageHeader, columns);
    report.detail.height = 0.3;
    addValues(report.detail, columns);
    report.detail.height += 0.3;
    addTotal(report.reportFooter, Total::Of::Count, u"Total de registos listados:"_s, u"no_kor"_s,
             {});
    addTotal(report.reportFooter, Total::Of::Sum, u"Total de Débitos:"_s, summed,
             core::format::Money);
    return report;
}

}  // namespace

Report Print_frmTRF_CHQ() {
    return paymentList(u"Print_frmTRF_CHQ"_s, u"Listagem de Pagamentos por Cheque"_s,
                       {u"No. de Cheque"_s, u"cheque"_s, 0}, u"tcredito"_s);
}

Report Print_frmTRF_TRF() {
    return paymentList(u"Print_frmTRF_TRF"_s, u"Listagem de Transferências Bancárias"_s,
                       {u"NIB"_s, u"nib"_s, 0}, u"tdebito"_s);
}

}  // namespace reports
