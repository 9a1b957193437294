// SPDX-License-Identifier: MIT
#pragma once

#include "masterdata/Deletion.h"

namespace masterdata {

/// One rubric; with 0 none, which gives an empty set that rows can be added to.
inline QString rubricQuery(qint32 rubrica_id) {
    return QStringLiteral("SELECT * From tbZelmar_plafonds WHERE rubrica_id = ") +
           QString::number(rubrica_id);
}

/// The rubrics of a group.
inline QString childrenQuery(qint32 rubrica_id) {
    return QStringLiteral("SELECT * From tbZelmar_plafonds WHERE rubrica_id_main = ") +
           QString::number(rubrica_id);
}

/// The deletion of a rubric. Intentional: members who have left and closed years keep none.
inline Deletion rubricDeletion(qint32 rubrica_id) {
    const QString id = QString::number(rubrica_id);
    return {
        .related = {QStringLiteral("Select * from tbSocios_Acumulados where rubrica_id = ") + id,
                    QStringLiteral("Select * from tbZelmar_Movimentos where rubrica_id = ") + id},
        .row = QStringLiteral("Select * from tbZelmar_Plafonds where rubrica_id = ") + id,
        .missing = QStringLiteral(
            "Não é possível apagar este registo porque não foi possível encontrar o registo na "
            "tabela.")};
}

}  // namespace masterdata
