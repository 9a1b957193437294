// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QVariant>

/// The queries of the coverage rules. Values are joined in as they stand: numbers bare, texts
/// between single quotes with no escaping.
namespace coverage::queries {

/// One row: a rubric.
QString rubric(const QVariant& rubrica_id);
/// Accumulators of one member, person and rubric.
/// @param table  that of the active members, or of those who have left
QString accumulator(const QVariant& rubrica_id, qint32 socio_id, const QString& codABC,
                    const QString& table = QStringLiteral("tbSocios_Acumulados"));
/// Every accumulator of the active members.
QString accumulators();
/// One row: the credit of a rubric, the member and all his family, as `sum_credito_agregado`.
QString creditOfHousehold(const QVariant& rubrica_id, qint32 socio_id);
/// One row: the credit of a rubric, the relatives alone, as `sum_credito_tfamilia`.
QString creditOfRelatives(const QVariant& rubrica_id, qint32 socio_id);
/// One row: the credit of a main rubric's group for one person, as `Tagregado`.
QString groupCreditOfPerson(const QVariant& main, const QString& codABC, qint32 socio_id);
/// One row: the same for the member and all his family.
QString groupCreditOfHousehold(const QVariant& main, qint32 socio_id);
/// One row: the same for the relatives alone.
QString groupCreditOfRelatives(const QVariant& main, qint32 socio_id);
/// One row: a member's debits and credits over all his accumulators, as `tdebito_ac`,
/// `tcredito_ac`.
QString balance(qint32 socio_id);
/// One row: what of the franchise is spent, whole family and every type of movement. Intentional:
/// the alias `t_iliquido` sums `liquido`, whatever its name says.
QString franchise(qint32 socio_id, const QVariant& rubrica_id);
/// Every rubric, by code, with what the lists show of it as `completo`.
QString rubrics();
/// Every accumulator of one member, in order of insertion.
QString accumulatorsOf(qint32 socio_id);
/// A row for each value of the columns: a member's credit, he and all his family, as `soma`.
/// @param columns  of the accumulators, parted by commas
QString creditsBy(const QString& columns, qint32 socio_id);
/// The same of the relatives alone.
QString creditsOfRelativesBy(const QString& columns, qint32 socio_id);
/// franchise() for every rubric at once, each row with its `rubrica_id`.
QString franchises(qint32 socio_id);
/// One row: a member.
QString member(qint32 socio_id);

}  // namespace coverage::queries
