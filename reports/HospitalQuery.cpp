// SPDX-License-Identifier: MIT
#include "reports/HospitalQuery.h"

using namespace Qt::StringLiterals;

namespace reports {

namespace {

/// The condition on a table's days.
QString inPeriod(const QString& table, const QDate& first, const QDate& last) {
    // Intentional: the day is written month first beside the style of another order.
    const auto midnight = [](const QDate& day) {
        return u"CONVERT(DATETIME, '"_s + day.toString(u"MM/dd/yyyy"_s) + u" 00:00:00',102)"_s;
    };
    return u'(' + table + u".data >= "_s + midnight(first) + u") AND ("_s + table + u".data <= "_s +
           midnight(last) + u") "_s;
}

/// The hospitals with a bill among the movements of a table.
QString hospitals(const QString& table, const QDate& first, const QDate& last) {
    return u"SELECT %1.hospital_id, tbHospitais.nome AS hospital_nome, tbHospitais.code AS "
           "hospital_code From %1 LEFT JOIN tbHospitais ON %1.hospital_id = "
           "tbHospitais.hospital_id WHERE (%1.tipo = 'HOS') AND "_s.arg(table) +
           inPeriod(table, first, last) +
           u"GROUP BY %1.hospital_id, tbHospitais.nome, tbHospitais.code "_s.arg(table);
}

/// The movements of all kinds of the tables that end with `suffix`: "" or "_Inactivos".
QString movements(const QString& suffix, const QDate& first, const QDate& last) {
    return u"SELECT tbzelmar_movimentos%1.*, debito - credito AS divida, tbsocios%1.no_kor, "
           "tbZelmar_Plafonds.code AS rubrica FROM ((tbzelmar_movimentos%1 LEFT OUTER JOIN "
           "tbsocios%1 ON tbzelmar_movimentos%1.socio_id = tbsocios%1.socio_id) LEFT OUTER JOIN "
           "tbZelmar_Plafonds ON tbzelmar_movimentos%1.rubrica_id = "
           "tbZelmar_Plafonds.rubrica_id) WHERE "_s.arg(suffix) +
           inPeriod(u"tbZelmar_Movimentos"_s + suffix, first, last);
}

}  // namespace

QString hospitalListQuery(const QDate& first, const QDate& last) {
    return u"SHAPE {"_s + hospitals(u"tbZelmar_Movimentos"_s, first, last) + u"UNION "_s +
           hospitals(u"tbZelmar_Movimentos_Inactivos"_s, first, last) +
           u"ORDER BY tbHospitais.nome }  AS Print_frmListagemHospitais APPEND ({"_s +
           movements({}, first, last) + u"UNION "_s + movements(u"_Inactivos"_s, first, last) +
           u"ORDER BY movimento_id } AS Print_frmListagemHospitais_detail RELATE 'hospital_id' TO "
           "'hospital_id') AS Print_frmListagemHospitais_detail"_s;
}

}  // namespace reports
