// SPDX-License-Identifier: MIT
#include "reports/TaxQuery.h"

using namespace Qt::StringLiterals;

namespace reports {

QString taxQuery(const TaxSelection& selection) {
    QString positions = u" AND ("_s;
    for (qsizetype at = 0; at < selection.codes.size(); ++at)
        positions += (at == 0 ? u" codABC='"_s : u" OR codABC='"_s) + selection.codes[at] + u'\'';
    positions += u" ) "_s;
    // Only documents and bills are costs. Intentional: the share of the plan is called `tcredito`,
    // though it is the sum of `debito`.
    return (selection.socio_id
                ? u"SELECT ano, no_kor, nome, morada, localidade_completo, no_contribuinte, "
                  "sum(doc_valor - debito - recebido) AS tresponsabilidade, sum(doc_valor) as "
                  "tdoc_valor, sum(debito) as tcredito, sum(recebido) as trecebido "_s
                : u"SELECT ano, no_kor, nome, morada, localidade_completo, no_contribuinte,  "
                  "sum(doc_valor - debito - recebido) AS tresponsabilidade ,sum(doc_valor) as "
                  "tdoc_valor, sum(debito) as tcredito, sum(recebido) as trecebido "_s) +
           u"From tbZelmar_Movimentos_historico "
           u"WHERE (tipo='DOC' or tipo='HOS') AND ano="_s +
           selection.year + u' ' + positions +
           (selection.socio_id ? u" AND socio_id="_s + QString::number(*selection.socio_id)
                               : QString()) +
           u"GROUP BY ano,no_kor,nome,morada,localidade_completo,no_contribuinte "
           u"ORDER BY no_kor "_s;
}

}  // namespace reports
