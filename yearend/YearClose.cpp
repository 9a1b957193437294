// SPDX-License-Identifier: MIT
#include "yearend/YearClose.h"

#include "boundary/environment/dtZelmars.h"
#include "data/NewMovement.h"
#include "platform/ado/GatheredWrites.h"
#include "platform/core/Clock.h"
#include "platform/core/Single.h"
#include "platform/core/Values.h"
#include "yearend/BulkRows.h"

using namespace Qt::StringLiterals;

namespace yearend {

namespace {

using ado::RecordsetPtr;
using core::Single;

const QString DebtsOfMembers =
    u"SELECT tbZelmar_Movimentos.socio_id, Sum(debito-credito) AS divida FROM tbZelmar_Movimentos "
    "LEFT OUTER JOIN tbZelmar_Plafonds ON tbZelmar_Movimentos.rubrica_id = "
    "tbZelmar_Plafonds.rubrica_id GROUP BY tbZelmar_Movimentos.socio_id Having (((Sum(Debito - "
    "Credito)) > 0.1)) ORDER BY tbZelmar_Movimentos.socio_id"_s;

const QString DebtsOfThoseWhoLeft =
    u"SELECT tbZelmar_Movimentos_Inactivos.socio_id, Sum(debito-credito) AS divida FROM "
    "tbZelmar_Movimentos_Inactivos LEFT OUTER JOIN tbZelmar_Plafonds ON "
    "tbZelmar_Movimentos_Inactivos.rubrica_id = tbZelmar_Plafonds.rubrica_id GROUP BY "
    "tbZelmar_Movimentos_Inactivos.socio_id Having (((Sum(Debito - Credito)) > 0.1)) ORDER BY "
    "tbZelmar_Movimentos_Inactivos.socio_id"_s;

const QString MovementsOfMembers =
    u"SELECT tbZelmar_Movimentos.*, tbSocios.no_kor, tbSocios.nome, tbSocios.nome_guerra, "
    "tbSocios.no_contribuinte, tbSocios_Familias.nome AS nome_familiar, tbSocios.morada1 as "
    "morada, tbSocios.code_postal1 + ' ' + tbSocios.localidade1 as localidade_completo FROM "
    "(tbZelmar_Movimentos LEFT OUTER JOIN tbSocios ON tbZelmar_Movimentos.socio_id = "
    "tbSocios.socio_id) LEFT OUTER JOIN tbSocios_Familias ON (tbZelmar_Movimentos.codABC = "
    "tbSocios_Familias.codABC) AND (tbZelmar_Movimentos.socio_id = tbSocios_Familias.socio_id)"_s;

const QString MovementsOfThoseWhoLeft =
    u"SELECT tbZelmar_Movimentos_Inactivos.*, tbSocios_Inactivos.no_kor, tbSocios_Inactivos.nome, "
    "tbSocios_Inactivos.nome_guerra, tbSocios_Inactivos.no_contribuinte, "
    "tbSocios_Familias_Inactivos.nome AS nome_familiar, tbSocios_inactivos.morada1 as morada, "
    "tbSocios_inactivos.code_postal1 + ' ' + tbSocios_inactivos.localidade1 as "
    "localidade_completo FROM (tbZelmar_Movimentos_Inactivos LEFT OUTER JOIN tbSocios_Inactivos ON "
    "tbZelmar_Movimentos_Inactivos.socio_id = tbSocios_Inactivos.socio_id) LEFT OUTER JOIN "
    "tbSocios_Familias_Inactivos ON (tbZelmar_Movimentos_Inactivos.codABC = "
    "tbSocios_Familias_Inactivos.codABC) AND (tbZelmar_Movimentos_Inactivos.socio_id = "
    "tbSocios_Familias_Inactivos.socio_id)"_s;

/// @param writesBoth  the other one of the two sums is written, too; where it is not, the table's
/// default has to be 0
void carryDebts(const QString& debts, const QString& accumulators, bool writesBoth,
                const Serve& serve) {
    const RecordsetPtr owed = openBulk(debts);
    const RecordsetPtr target = openBulk(accumulators, ado::adOpenStatic, ado::adLockOptimistic);
    for (; !owed->atEnd(); owed->MoveNext()) {
        const Single divida(owed->Collect(u"divida"_s));
        // Intentional: what is owed is always above 0 here; a credit would go where it belongs.
        const bool isDebt = divida > Single();
        target->AddNew();
        target->setCollect(u"socio_id"_s, Single(owed->Collect(u"socio_id"_s)));
        target->setCollect(isDebt ? u"debito_ac"_s : u"credito_ac"_s, divida);
        if (writesBoth) target->setCollect(isDebt ? u"credito_ac"_s : u"debito_ac"_s, 0);
        target->Update();
        serve();
    }
    owed->Close();
    target->Close();
}

/// What goes from a movement to history: all columns but the key and a former server's row version.
class HistoryColumns {
public:
    HistoryColumns(ado::Recordset& movements, ado::Recordset& history) {
        for (int column = 1; column < movements.columnCount(); ++column) {
            const QString name = movements.Fields(column).Name();
            if (name.compare("upsize_ts"_L1, Qt::CaseInsensitive) != 0)
                pairs_.emplace_back(column, history.columnOf(name));
        }
    }
    void copy(const ado::Recordset& movement, ado::Recordset& into) const {
        for (const auto& [from, to] : pairs_) into.copyValue(to, movement, from);
    }

private:
    std::vector<std::pair<int, int>> pairs_;
};

void copyToHistory(ado::Recordset& movements, ado::Recordset& history, const QString& year,
                   CloseView& view) {
    if (movements.atEnd()) return;
    const HistoryColumns columns(movements, history);
    for (; !movements.atEnd(); movements.MoveNext()) {
        history.AddNew();
        columns.copy(movements, history);
        history.setCollect(u"ano"_s, core::toLong(year));
        history.Update();
        view.movementCopied();
        view.serve();
    }
}

void moveToHistory(const QString& year, CloseView& view) {
    const RecordsetPtr ofMembers =
        openBulk(MovementsOfMembers, ado::adOpenKeyset, ado::adLockOptimistic);
    const RecordsetPtr ofThoseWhoLeft =
        openBulk(MovementsOfThoseWhoLeft, ado::adOpenKeyset, ado::adLockOptimistic);
    int movements = 0;
    if (!ofMembers->atEnd()) movements += countFromLast(*ofMembers);
    if (!ofThoseWhoLeft->atEnd()) movements += static_cast<int>(ofThoseWhoLeft->RecordCount());
    view.historyBegun(movements);
    // The condition keeps the set small; its rows are not looked at.
    const RecordsetPtr history =
        openBulk(u"Select * from tbZelmar_Movimentos_Historico where ano>"_s + year,
                 ado::adOpenStatic, ado::adLockOptimistic);
    copyToHistory(*ofMembers, *history, year, view);
    ofMembers->Close();
    copyToHistory(*ofThoseWhoLeft, *history, year, view);
    ofThoseWhoLeft->Close();
    history->Close();
}

/// The set of the counter, which stands at 1 then.
RecordsetPtr restartCounter() {
    const RecordsetPtr counter =
        openBulk(data::CounterQuery.toString(), ado::adOpenDynamic, ado::adLockPessimistic);
    if (counter->atEnd()) counter->AddNew();
    counter->setCollect(u"zelmars"_s, 1);
    counter->Update();
    return counter;
}

void openYear(ado::Recordset& counter, const QString& movements, const QString& accumulators,
              const Serve& serve) {
    const RecordsetPtr target = openBulk(movements, ado::adOpenStatic, ado::adLockOptimistic);
    const RecordsetPtr owed = openBulk(accumulators);
    for (; !owed->atEnd(); owed->MoveNext()) {
        const qint32 number = core::toLong(counter.Collect(u"zelmars"_s));
        target->AddNew();
        target->setCollect(u"socio_id"_s, core::toLong(owed->Collect(u"socio_id"_s)));
        target->setCollect(u"data"_s, core::fromDate(core::today()));
        target->setCollect(u"tipo"_s, u"SA"_s);
        target->setCollect(u"credito"_s, Single(owed->Collect(u"credito_ac"_s)));
        target->setCollect(u"debito"_s, Single(owed->Collect(u"debito_ac"_s)));
        target->setCollect(u"movimento_no"_s, number);
        target->Update();
        counter.setCollect(u"zelmars"_s, number + 1);
        counter.Update();
        serve();
    }
    target->Close();
    owed->Close();
}

/// Runs one phase, at whose end its writes are on the disk.
template <class Work>
void run(ClosePhase& phase, ClosePhase now, const Work& work) {
    phase = now;
    ado::GatheredWrites writes(environment::dtZelmars::instance().MSAccess());
    work();
    writes.store();
}

}  // namespace

void closeYear(const QString& year, CloseView& view, ClosePhase& phase) {
    const Serve serve = [&] { view.serve(); };
    const QString accumulators = u"Select * from tbSocios_Acumulados"_s;
    const QString accumulatorsLeft = u"Select * from tbSocios_Acumulados_Inactivos"_s;
    run(phase, ClosePhase::Debts, [&] {
        empty(accumulators, ado::adOpenStatic, serve);
        view.debtsAt(1);
        empty(u"Select * from tbSocios_Acumulados_inactivos"_s, ado::adOpenStatic, serve);
        view.debtsAt(2);
        carryDebts(DebtsOfMembers, accumulators, true, serve);
        view.debtsAt(4);
        // Intentional: of those who have left only the one sum is written.
        carryDebts(DebtsOfThoseWhoLeft, accumulatorsLeft, false, serve);
        view.debtsAt(6);
    });
    run(phase, ClosePhase::History, [&] { moveToHistory(year, view); });
    run(phase, ClosePhase::Emptying, [&] {
        empty(u"Select * from tbZelmar_Movimentos"_s, ado::adOpenDynamic, serve);
        empty(u"Select * from tbZelmar_Movimentos_inactivos"_s, ado::adOpenDynamic, serve);
    });
    phase = ClosePhase::NewYear;
    // The counter's row may be a new one, and a row that is gathered cannot be gone on with.
    const RecordsetPtr counter = restartCounter();
    run(phase, ClosePhase::NewYear, [&] {
        openYear(*counter, u"Select * from tbZelmar_Movimentos"_s, accumulators, serve);
        openYear(*counter, u"Select * from tbZelmar_Movimentos_Inactivos"_s, accumulatorsLeft,
                 serve);
        counter->Close();
    });
    phase = ClosePhase::Done;
}

}  // namespace yearend
