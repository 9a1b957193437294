// SPDX-License-Identifier: MIT
#include "coverage/Queries.h"

#include "platform/core/Values.h"

using namespace Qt::StringLiterals;

namespace coverage::queries {

QString rubric(const QVariant& rubrica_id) {
    return u"Select * from tbZelmar_plafonds where rubrica_id ="_s + core::toText(rubrica_id);
}

QString accumulator(const QVariant& rubrica_id, qint32 socio_id, const QString& codABC,
                    const QString& table) {
    return u"Select * from "_s + table + u" WHERE (rubrica_id ="_s + core::toText(rubrica_id) +
           u") AND (socio_id="_s + QString::number(socio_id) + u") AND (codABC='"_s + codABC +
           u"')"_s;
}

QString accumulators() {
    return u"Select * from tbSocios_Acumulados"_s;
}

QString creditOfHousehold(const QVariant& rubrica_id, qint32 socio_id) {
    return u"SELECT tbSocios_Acumulados.socio_id, tbSocios_Acumulados.rubrica_id, "
           "Sum(tbSocios_Acumulados.credito_ac) AS sum_credito_agregado "
           "From tbSocios_Acumulados WHERE (rubrica_id ="_s +
           core::toText(rubrica_id) + u") AND (socio_id="_s + QString::number(socio_id) +
           u") GROUP BY tbSocios_Acumulados.socio_id, tbSocios_Acumulados.rubrica_id"_s;
}

QString creditOfRelatives(const QVariant& rubrica_id, qint32 socio_id) {
    return u"SELECT tbSocios_Acumulados.socio_id, tbSocios_Acumulados.rubrica_id, "
           "Sum(tbSocios_Acumulados.credito_ac) AS sum_credito_tfamilia "
           "From tbSocios_Acumulados WHERE ((tbSocios_Acumulados.codABC <> 'A') AND (rubrica_id ="_s +
           core::toText(rubrica_id) + u") AND (socio_id="_s + QString::number(socio_id) +
           u")) GROUP BY tbSocios_Acumulados.socio_id, tbSocios_Acumulados.rubrica_id"_s;
}

QString groupCreditOfPerson(const QVariant& main, const QString& codABC, qint32 socio_id) {
    return u"SELECT tbSocios_Acumulados.rubrica_id_main, Sum(tbSocios_Acumulados.credito_ac) AS "
           "Tagregado From tbSocios_Acumulados WHERE (((tbSocios_Acumulados.rubrica_id_main) = "_s +
           core::toText(main) + u") And ((tbSocios_Acumulados.codABC) = '"_s + codABC +
           u"') AND ((tbSocios_Acumulados.socio_id) = "_s + QString::number(socio_id) +
           u")) GROUP BY tbSocios_Acumulados.rubrica_id_main"_s;
}

QString groupCreditOfHousehold(const QVariant& main, qint32 socio_id) {
    return u"SELECT tbSocios_Acumulados.rubrica_id_main, Sum(tbSocios_Acumulados.credito_ac) AS "
           "Tagregado From tbSocios_Acumulados WHERE (((tbSocios_Acumulados.rubrica_id_main) = "_s +
           core::toText(main) + u") AND (socio_id="_s + QString::number(socio_id) +
           u")) GROUP BY tbSocios_Acumulados.rubrica_id_main"_s;
}

QString groupCreditOfRelatives(const QVariant& main, qint32 socio_id) {
    return u"SELECT tbSocios_Acumulados.rubrica_id_main, Sum(tbSocios_Acumulados.credito_ac) AS "
           "Tagregado From tbSocios_Acumulados Where (((tbSocios_Acumulados.rubrica_id_main) = "_s +
           core::toText(main) + u") And ((tbSocios_Acumulados.codABC) <> 'A') AND (socio_id="_s +
           QString::number(socio_id) + u")) GROUP BY tbSocios_Acumulados.rubrica_id_main"_s;
}

QString balance(qint32 socio_id) {
    return u"SELECT tbSocios_Acumulados.socio_id, Sum(tbSocios_Acumulados.debito_ac) AS "
           "tdebito_ac, Sum(tbSocios_Acumulados.credito_ac) AS tcredito_ac From "
           "tbSocios_Acumulados WHERE tbSocios_Acumulados.socio_id = "_s +
           QString::number(socio_id) + u" GROUP BY tbSocios_Acumulados.socio_id"_s;
}

QString franchise(qint32 socio_id, const QVariant& rubrica_id) {
    return u"SELECT socio_id, Sum(liquido) AS t_iliquido, Sum(credito) AS t_credito FROM "
           "tbZelmar_Movimentos WHERE tbZelmar_Movimentos.socio_id = "_s +
           QString::number(socio_id) + u" AND tbZelmar_Movimentos.rubrica_id = "_s +
           core::toText(rubrica_id) + u" GROUP BY tbZelmar_Movimentos.socio_id"_s;
}

QString rubrics() {
    return u"SELECT tbZelmar_Plafonds.*, code + '  -  ' + descrit AS completo FROM "
           "tbZelmar_Plafonds ORDER BY code"_s;
}

QString accumulatorsOf(qint32 socio_id) {
    return u"Select * from tbSocios_Acumulados WHERE socio_id="_s + QString::number(socio_id);
}

QString creditsBy(const QString& columns, qint32 socio_id) {
    return u"SELECT %1, Sum(credito_ac) AS soma FROM tbSocios_Acumulados WHERE socio_id=%2 GROUP BY %1"_s
        .arg(columns, QString::number(socio_id));
}

QString creditsOfRelativesBy(const QString& columns, qint32 socio_id) {
    return u"SELECT %1, Sum(credito_ac) AS soma FROM tbSocios_Acumulados WHERE socio_id=%2 AND "
           "codABC <> 'A' GROUP BY %1"_s.arg(columns, QString::number(socio_id));
}

QString franchises(qint32 socio_id) {
    return u"SELECT rubrica_id, Sum(liquido) AS t_iliquido, Sum(credito) AS t_credito FROM "
           "tbZelmar_Movimentos WHERE socio_id = %1 GROUP BY rubrica_id"_s.arg(socio_id);
}

QString member(qint32 socio_id) {
    return u"Select * from tbSocios where socio_id="_s + QString::number(socio_id);
}

}  // namespace coverage::queries
