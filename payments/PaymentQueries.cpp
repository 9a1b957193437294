// SPDX-License-Identifier: MIT
#include "payments/PaymentQueries.h"

using namespace Qt::StringLiterals;

namespace payments {

namespace {

/// The condition on the days and on the mode of payment.
QString listed(const QString& table, const QDate& first, const QDate& last, const QString& mode) {
    const auto midnight = [](const QDate& date) {
        return u"CONVERT(DATETIME,'"_s + date.toString(u"MM/dd/yyyy"_s) + u" 00:00:00', 102)"_s;
    };
    return u"WHERE ("_s + table + u".data >= "_s + midnight(first) + u") AND ("_s + table +
           u".data <= "_s + midnight(last) + mode;
}

}  // namespace

QString chequeListQuery(const QDate& first, const QDate& last) {
    const QString mode = u") AND (%1.modo_pagamento = 'CHQ') "_s;
    return u"SELECT tbZelmar_Movimentos.socio_id, tbZelmar_Movimentos.cheque, tbSocios.no_kor, "
           "tbSocios.nome_guerra, SUM(tbZelmar_Movimentos.Credito) As tcredito "
           "FROM tbZelmar_Movimentos LEFT JOIN tbSocios ON tbZelmar_Movimentos.Socio_ID = "
           "tbSocios.Socio_ID "_s +
           listed(u"tbZelmar_Movimentos"_s, first, last, mode.arg(u"tbZelmar_Movimentos"_s)) +
           u"GROUP BY tbZelmar_Movimentos.socio_id,tbZelmar_Movimentos.cheque, tbSocios.no_kor, "
           "tbSocios.nome_guerra "
           "HAVING SUM(tbZelmar_Movimentos.Credito) > 0.1 "
           "UNION "
           "SELECT tbZelmar_Movimentos_Inactivos.socio_id, tbZelmar_Movimentos_Inactivos.cheque, "
           "tbSocios_Inactivos.no_kor, tbSocios_Inactivos.nome_guerra, "
           "SUM(tbZelmar_Movimentos_Inactivos.Credito) As tcredito "
           "FROM tbZelmar_Movimentos_Inactivos LEFT JOIN tbSocios_Inactivos ON "
           "tbZelmar_Movimentos_Inactivos.Socio_ID = tbSocios_Inactivos.Socio_ID "_s +
           listed(u"tbZelmar_Movimentos_Inactivos"_s, first, last,
                  mode.arg(u"tbZelmar_Movimentos_Inactivos"_s)) +
           u"GROUP BY tbZelmar_Movimentos_Inactivos.socio_id,"
           "tbZelmar_Movimentos_Inactivos.cheque, tbSocios_Inactivos.no_kor, "
           "tbSocios_Inactivos.nome_guerra "
           "HAVING SUM(tbZelmar_Movimentos_Inactivos.Credito) > 0.1 ORDER BY no_kor"_s;
}

QString transferListQuery(const QDate& first, const QDate& last) {
    const QString mode = u") And (%1.modo_pagamento = 'TRF') "_s;
    return u"SELECT tbZelmar_Movimentos.socio_id, tbSocios.no_kor, tbSocios.nome_guerra, "
           "tbSocios.nib, Sum(tbZelmar_Movimentos.debito) AS tdebito "
           "FROM tbZelmar_Movimentos LEFT JOIN tbSocios ON tbZelmar_Movimentos.socio_id = "
           "tbSocios.socio_id "_s +
           listed(u"tbZelmar_Movimentos"_s, first, last, mode.arg(u"tbZelmar_Movimentos"_s)) +
           u"GROUP BY tbZelmar_Movimentos.socio_id, tbSocios.no_kor, tbSocios.nome_guerra, "
           "tbSocios.nib "
           "HAVING SUM(tbZelmar_Movimentos.debito) > 1 "
           "UNION "
           "SELECT tbZelmar_Movimentos_Inactivos.socio_id, tbSocios_Inactivos.no_kor, "
           "tbSocios_Inactivos.nome_guerra, tbSocios_Inactivos.nib, "
           "Sum(tbZelmar_Movimentos_Inactivos.debito) AS tdebito "
           "FROM tbZelmar_Movimentos_Inactivos LEFT JOIN tbSocios_Inactivos ON "
           "tbZelmar_Movimentos_Inactivos.socio_id = tbSocios_Inactivos.socio_id "_s +
           listed(u"tbZelmar_Movimentos_Inactivos"_s, first, last,
                  mode.arg(u"tbZelmar_Movimentos_Inactivos"_s)) +
           u"GROUP BY tbZelmar_Movimentos_Inactivos.socio_id, tbSocios_Inactivos.no_kor, "
           "tbSocios_Inactivos.nome_guerra, tbSocios_Inactivos.nib "
           "HAVING SUM(tbZelmar_Movimentos_Inactivos.debito) > 1 ORDER BY no_kor"_s;
}

QString transferMovementsQuery(const QDate& first, const QDate& last, bool left) {
    const QString table = left ? u"tbZelmar_Movimentos_Inactivos"_s : u"tbZelmar_Movimentos"_s;
    return u"SELECT movimento_id, movimento_no, socio_id, debito FROM "_s + table + u' ' +
           listed(table, first, last, u") AND (%1.modo_pagamento = 'TRF') "_s.arg(table)) +
           u"ORDER BY movimento_id"_s;
}

QString typedTransfersQuery(const QDate& first, const QDate& last) {
    const auto day = [](const QDate& date) { return date.toString(u"M/d/yyyy"_s); };
    return u"SELECT tbZelmar_Movimentos.socio_id, tbSocios.no_kor, tbSocios.nome_guerra, "
           "tbSocios.nib, Sum(tbZelmar_Movimentos.debito) AS tdebito "
           "FROM tbZelmar_Movimentos LEFT JOIN tbSocios ON tbZelmar_Movimentos.socio_id = "
           "tbSocios.socio_id "
           "WHERE (tbZelmar_Movimentos.data >= #"_s +
           day(first) + u"#) AND (tbZelmar_Movimentos.data <= #"_s + day(last) +
           u"#) And (tbZelmar_Movimentos.modo_pagamento = 'TRF') "
           "GROUP BY tbZelmar_Movimentos.socio_id, tbSocios.no_kor, tbSocios.nome_guerra, "
           "tbSocios.nib "
           "HAVING SUM(tbZelmar_Movimentos.debito) > 1"_s;
}

}  // namespace payments
