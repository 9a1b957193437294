// SPDX-License-Identifier: MIT
#include "yearend/Rebuild.h"

#include "boundary/environment/dtZelmars.h"
#include "data/Operations.h"
#include "platform/ado/GatheredWrites.h"
#include "platform/core/Values.h"
#include "yearend/BulkRows.h"

using namespace Qt::StringLiterals;

namespace yearend {

namespace {

/// Null repair of one table of movements.
void repairNulls(Stage stage, const QString& query, RebuildView& view) {
    static const QStringList amounts{u"incidencia"_s, u"recebido"_s, u"doc_valor"_s, u"debito"_s,
                                     u"credito"_s};
    const ado::RecordsetPtr rows = openBulk(query, ado::adOpenStatic, ado::adLockOptimistic);
    view.begun(stage, rows->atEnd() ? 0 : countFromLast(*rows));
    std::vector<int> columns;
    const auto isNull = [&](int column) { return rows->readCell(column).kind == ado::Cell::Null; };
    if (!rows->atEnd())
        for (const QString& amount : amounts) columns.push_back(rows->columnOf(amount));
    for (; !rows->atEnd(); rows->MoveNext()) {
        bool isChanged = false;
        for (const int column : columns) {
            if (!isNull(column)) continue;
            rows->setValue(column, 0);
            isChanged = true;
        }
        if (isChanged) rows->Update();
        view.rowDone(stage);
        view.serve();
    }
    rows->Close();
    view.done(stage);
}

struct Accumulated {
    Stage stage;
    QString emptied;  ///< the query that gives the table's rows
    QString sums;     ///< one row for each member, person and rubric
    bool ofMembers;   ///< not of those who have left
};

void addRow(const ado::Recordset& sums, ado::Recordset& accumulators) {
    const auto given = [&](const QString& column) { return sums.Collect(column); };
    const QVariant person = given(u"codABC"_s);
    const QVariant rubric = given(u"rubrica_id"_s);
    accumulators.AddNew();
    accumulators.setCollect(u"socio_id"_s, given(u"socio_id"_s));
    accumulators.setCollect(u"codABC"_s, core::isNull(person) ? u""_s : person);
    accumulators.setCollect(u"rubrica_id"_s, core::isNull(rubric) ? 0 : core::toLong(rubric));
    accumulators.setCollect(u"rubrica_id_main"_s, given(u"rubrica_id_main"_s));
    accumulators.setCollect(u"debito_ac"_s, given(u"tdebito"_s));
    accumulators.setCollect(u"credito_ac"_s, given(u"tcredito"_s));
    accumulators.setCollect(u"no_docs"_s, given(u"no_docs"_s));
    accumulators.Update();
}

void rebuild(const Accumulated& table, RebuildView& view) {
    view.waitBegun();
    empty(table.emptied, ado::adOpenStatic, [&] { view.serve(); });
    // What comes counts every movement, also one whose operation was cut short before it was added.
    data::journal::closeAccumulations(table.ofMembers);
    const ado::RecordsetPtr target =
        openBulk(table.emptied, ado::adOpenStatic, ado::adLockOptimistic);
    const ado::RecordsetPtr sums = openBulk(table.sums, ado::adOpenStatic, ado::adLockOptimistic);
    view.waitDone();
    view.begun(table.stage, sums->atEnd() ? 0 : countFromLast(*sums));
    for (; !sums->atEnd(); sums->MoveNext()) {
        addRow(*sums, *target);
        view.rowDone(table.stage);
        view.serve();
    }
    sums->Close();
    target->Close();
    view.done(table.stage);
}

const QString SumsOfMembers =
    u"SELECT tbZelmar_Movimentos.socio_id, tbZelmar_Movimentos.codABC, "
    "tbZelmar_Movimentos.rubrica_id, Sum(tbZelmar_Movimentos.debito) AS tdebito, "
    "Sum(tbZelmar_Movimentos.credito) AS tcredito, Count(tbZelmar_Movimentos.movimento_id) AS "
    "no_docs, tbZelmar_Plafonds.rubrica_id_main "
    "FROM tbZelmar_Movimentos LEFT JOIN tbZelmar_Plafonds ON "
    "tbZelmar_Movimentos.rubrica_id=tbZelmar_Plafonds.rubrica_id "
    "GROUP BY tbZelmar_Movimentos.socio_id, tbZelmar_Movimentos.codABC, "
    "tbZelmar_Movimentos.rubrica_id, tbZelmar_Plafonds.rubrica_id_main "
    "ORDER BY tbZelmar_Movimentos.socio_id,tbZelmar_Movimentos.codABC, "
    "tbZelmar_Movimentos.rubrica_id "_s;

const QString SumsOfThoseWhoLeft =
    u"SELECT tbZelmar_Movimentos_Inactivos.socio_id, tbZelmar_Movimentos_Inactivos.codABC, "
    "tbZelmar_Movimentos_Inactivos.rubrica_id, Sum(tbZelmar_Movimentos_Inactivos.debito) AS "
    "tdebito, Sum(tbZelmar_Movimentos_Inactivos.credito) AS tcredito, "
    "Count(tbZelmar_Movimentos_Inactivos.movimento_id) AS no_docs, "
    "tbZelmar_Plafonds.rubrica_id_main "
    "FROM tbZelmar_Movimentos_Inactivos LEFT JOIN tbZelmar_Plafonds ON "
    "tbZelmar_Movimentos_Inactivos.rubrica_id=tbZelmar_Plafonds.rubrica_id "
    "GROUP BY tbZelmar_Movimentos_Inactivos.socio_id, tbZelmar_Movimentos_Inactivos.codABC, "
    "tbZelmar_Movimentos_Inactivos.rubrica_id, tbZelmar_Plafonds.rubrica_id_main "
    "ORDER BY tbZelmar_Movimentos_Inactivos.socio_id,tbZelmar_Movimentos_Inactivos.codABC, "
    "tbZelmar_Movimentos_Inactivos.rubrica_id "_s;

}  // namespace

void repairAndRebuild(RebuildView& view) {
    ado::GatheredWrites writes(environment::dtZelmars::instance().MSAccess());
    repairNulls(Stage::Movements, u"Select * from tbZelmar_Movimentos"_s, view);
    repairNulls(Stage::MovementsLeft, u"Select * from tbZelmar_Movimentos_Inactivos"_s, view);
    repairNulls(Stage::History, u"Select * from tbZelmar_Movimentos_Historico"_s, view);
    rebuild({Stage::Accumulators, u"Select * from tbSocios_Acumulados"_s, SumsOfMembers, true},
            view);
    rebuild({Stage::AccumulatorsLeft, u"Select * from tbSocios_Acumulados_Inactivos"_s,
             SumsOfThoseWhoLeft, false},
            view);
    writes.store();
}

}  // namespace yearend
